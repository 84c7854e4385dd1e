/// \file
/// A passing hash table over the units of a list of entries: a file with many keys loads in linear time.

#ifndef BASIS_CONTAINERS_DICT_INDEX_H
#define BASIS_CONTAINERS_DICT_INDEX_H

#include "basis/containers/dict_records.h"
#include "zor_basis/containers/dict.h"

#include <cstdint>
#include <memory>

namespace ZOR_Basis {

class DictIndex {
public:
    using Entry = DictEntry<Blob, Blob>;

    /// The entry of a key, or null after making place for it; the caller then gives `place()` its entry.
    Entry* find(RecordBytes key);
    /// Where the entry of a key that was not found belongs. \pre `find` has just given null
    Entry*& place() { return slots_[free_].entry; }

private:
    struct Slot {
        std::uint64_t hash;
        Entry* entry;
    };

    void grow();
    std::uint64_t freeSlot(std::uint64_t hash) const;

    std::unique_ptr<Slot[]> slots_;
    std::uint64_t mask_ = 0;
    std::uint64_t used_ = 0;
    std::uint64_t free_ = 0;
};

} // namespace ZOR_Basis

#endif
