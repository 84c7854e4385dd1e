/// \file
/// A list of values that sort by their keys alone, and helpers that make it, show it and find a place in it.

#ifndef TESTS_CONTAINERS_ITEM_LIST_H
#define TESTS_CONTAINERS_ITEM_LIST_H

#include <zor_basis/containers/sng_list.h>

#include <string>
#include <vector>

/// A value that sorts by its key alone and counts its living instances.
struct Item {
    Item(int k, int t) : key(k), tag(t) { ++living; }
    Item(Item const& other) : key(other.key), tag(other.tag) { ++living; }
    Item& operator=(Item const&) = default;
    ~Item() { --living; }
    bool operator<(Item const& other) const { return key < other.key; }

    int key;
    int tag;
    inline static int living = 0;
};

using List = ZOR_Basis::SngList<Item>;

/// The keys from the first to the last, each with its tag as a letter and a space.
inline std::string shown(List& list) {
    std::string found = list.isConsistent() ? "" : "inconsistent ";
    for (Item const& item : list) {
        std::string const letter = item.tag != 0 ? std::string(1, static_cast<char>('a' + item.tag - 1)) : "";
        found += std::to_string(item.key) + letter + " ";
    }
    return found;
}

inline List listOf(std::vector<Item> const& items) {
    List list;
    for (Item const& item : items) list.insertBack(item);
    return list;
}

inline List::iterator placeOf(List& list, std::ptrdiff_t index) {
    List::iterator place = list.begin();
    while (index-- > 0) ++place;
    return place;
}

#endif
