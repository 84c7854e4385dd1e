/// \file
/// A passing hash table over the units of a list of entries: a file with many keys loads in linear time.

#ifndef BASIS_STORE_DICT_INDEX_H
#define BASIS_STORE_DICT_INDEX_H

#include "basis/store/dict_records.h"
#include "zor_basis/store/dict_entry.h"

#include <cstdint>
#include <vector>

namespace ZOR_Basis {

class DictIndex {
public:
    using Entry = DictEntry<Blob, Blob>;

    /// The entry of a key; null if it has none yet, and then the caller makes it and calls `add`.
    Entry* find(RecordBytes key);
    /// Takes the entry of the key that `find` has just not found.
    void add(Entry* entry);

private:
    /// Small, as the table is what the processor's cache has to hold. There are fewer than 2^32 entries in any memory.
    struct Slot {
        std::uint32_t hash;
        std::uint32_t number; // of the entry, from 1; 0: free
    };

    void grow();
    Slot& freeSlot(std::uint32_t hash);

    std::vector<Slot> slots_;
    std::vector<Entry*> entries_;
    std::uint64_t mask_ = 0;
    std::uint32_t hash_ = 0; // of the key that was asked for last
};

} // namespace ZOR_Basis

#endif
