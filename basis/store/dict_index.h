/// \file
/// `DictIndex`: a hash table over the entries of a dictionary, so that a key is found without a search of the list.

#ifndef BASIS_STORE_DICT_INDEX_H
#define BASIS_STORE_DICT_INDEX_H

#include "zor_basis/store/dict_entry.h"

#include <cstdint>
#include <cstdlib>
#include <memory>

namespace ZOR_Basis {

/// Entries are borrowed; their keys are distinct and do not change while they are in the table.
class DictIndex {
public:
    using Entry = DictEntry<Blob, Blob>;

    /// \return null if the table does not have the key
    Entry* find(std::uint64_t size, char const* key) const;
    /// \return false, with nothing changed, if memory is short
    bool add(Entry* entry);
    /// \pre the table has the entry
    void remove(Entry const* entry);

private:
    /// A slot without an entry is free.
    struct Slot {
        Entry* entry;
        std::uint32_t hash;
    };
    struct Release {
        void operator()(Slot* slots) const { std::free(slots); }
    };

    std::uint64_t next(std::uint64_t at) const { return (at + 1) & mask_; }
    /// How far a slot is behind another one, in the order of a search.
    std::uint64_t distance(std::uint64_t from, std::uint64_t to) const { return (to - from) & mask_; }
    void put(Slot slot);
    bool grow();

    std::unique_ptr<Slot[], Release> slots_;
    std::uint64_t mask_ = 0;  // the number of slots, less one
    std::uint64_t limit_ = 0; // the number of entries that the table may have
    std::uint64_t count_ = 0;
};

} // namespace ZOR_Basis

#endif
