/// \file
/// `DictEntry<Blob, Blob>`: a key and its value in a dictionary.
///
/// \thread one thread at a time

#ifndef ZOR_BASIS_STORE_DICT_ENTRY_H
#define ZOR_BASIS_STORE_DICT_ENTRY_H

#include "zor_basis/containers/sng_list.h"
#include "zor_basis/store/blob.h"

#include <cstdint>

namespace ZOR_Basis {

template <class K, class V>
class DictEntry {
public:
    /// Constructs an entry with an empty value. Moving an entry copies it, like a blob.
    DictEntry(K const& newKey) : key(newKey) {}
    DictEntry(K const& newKey, V const& newValue) : key(newKey), value(newValue) {}
    DictEntry(DictEntry const& other) = default;
    DictEntry(DictEntry&& other) noexcept = default;
    DictEntry& operator=(DictEntry const& other) = default;
    DictEntry& operator=(DictEntry&& other) noexcept = default;

    /// Tells whether the entry has this key.
    bool eq(K const& other) const { return key == other; }
    /// Assigns a copy of a value, unless it is the entry's own.
    void set(V const& other) {
        if (&other != &value) value = other;
    }

    /// Tells whether key or value differ.
    bool operator!=(DictEntry const& other) const { return key != other.key || value != other.value; }
    /// Orders by the keys alone.
    bool operator<(DictEntry const& other) const { return key < other.key; }

    /// Public, as in a pair.
    K key;
    V value;
};

static_assert(sizeof(DictEntry<Blob, Blob>) == 2 * sizeof(Blob));

namespace detail {

/// A dictionary has to know when others may have changed its entries.
template <class K, class V>
struct UnitCount<DictEntry<K, V>> {
    std::uint64_t number = 0;
    mutable bool isExposed = false;

    void noteExposure() const { isExposed = true; }
    void endExposure() const { isExposed = false; }
};

} // namespace detail

} // namespace ZOR_Basis

#endif
