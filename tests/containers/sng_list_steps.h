/// \file
/// Random operations on a list and on a plain vector.

#ifndef TESTS_CONTAINERS_SNG_LIST_STEPS_H
#define TESTS_CONTAINERS_SNG_LIST_STEPS_H

#include "tests/containers/item_list.h"
#include "tests/support/operations.h"

#include <algorithm>
#include <cstdint>
#include <iterator>
#include <utility>
#include <vector>

namespace sng_list {

using Items = std::vector<Item>;

inline auto inOrder(bool ascending) {
    return [ascending](Item const& a, Item const& b) { return ascending ? a.key < b.key : b.key < a.key; };
}

inline void sortLikeList(Items& items, bool ascending) {
    if (items.size() == 2 && !inOrder(ascending)(items[0], items[1])) {
        std::swap(items[0], items[1]);
    } else if (items.size() != 2) {
        std::stable_sort(items.begin(), items.end(), inOrder(ascending));
    }
}

/// \tparam Random  makes numbers like those of the standard library's random sources
template <class Random>
struct ListBesideVector {
    explicit ListBesideVector(Random source) : random(std::move(source)) {}

    std::uint64_t below(std::uint64_t bound) { return random() % bound; }
    Item item() { return {static_cast<int>(below(10)), ++tag}; }
    /// An index from the first item to the end.
    std::ptrdiff_t index() { return static_cast<std::ptrdiff_t>(below(items.size() + 1)); }
    std::ptrdiff_t size() const { return static_cast<std::ptrdiff_t>(items.size()); }

    void sort(bool ascending) {
        list.sort(ascending);
        sortLikeList(items, ascending);
    }

    Random random;
    bool agree() {
        return list.isConsistent() && list.size() == items.size() &&
               std::equal(items.begin(), items.end(), list.begin(), list.end(),
                          [](Item const& a, Item const& b) { return a.tag == b.tag; });
    }

    List list;
    Items items;
    int tag = 0;
};

template <class Both>
void insertFront(Both& b) {
    Item const item = b.item();
    b.list.insertFront(item);
    b.items.insert(b.items.begin(), item);
}

template <class Both>
void insertBack(Both& b) {
    Item const item = b.item();
    b.list.insertBack(item);
    b.items.push_back(item);
}

template <class Both>
void insertAfter(Both& b) {
    Item const item = b.item();
    std::ptrdiff_t const index = b.index();
    List::iterator place = placeOf(b.list, index);
    b.list.insertAfter(item, place);
    b.items.insert(b.items.begin() + std::min(index + 1, b.size()), item);
}

template <class Both>
void insertBefore(Both& b) {
    Item const item = b.item();
    std::ptrdiff_t const index = b.index();
    List::iterator place = placeOf(b.list, index);
    b.list.insertBefore(item, place);
    b.items.insert(b.items.begin() + index, item);
}

template <class Both>
void remove(Both& b) {
    std::ptrdiff_t const index = b.index();
    List::iterator place = placeOf(b.list, index);
    b.list.remove(place);
    if (index < b.size()) b.items.erase(b.items.begin() + index);
}

template <class Both>
void takeFirst(Both& b) {
    delete b.list.takeFirst();
    if (!b.items.empty()) b.items.erase(b.items.begin());
}

template <class Both>
void reverse(Both& b) {
    b.list.reverse();
    std::reverse(b.items.begin(), b.items.end());
}

template <class Both>
void merge(Both& b) {
    bool const ascending = b.below(2) == 0;
    List other;
    Items others;
    for (std::uint64_t n = b.below(4); n > 0; --n) {
        others.push_back(b.item());
        other.insertBack(others.back());
    }
    b.sort(ascending);
    other.sort(ascending);
    sortLikeList(others, ascending);
    b.list.merge(other, ascending);
    Items merged; // of equal values the first range's come first
    std::merge(others.begin(), others.end(), b.items.begin(), b.items.end(), std::back_inserter(merged),
               inOrder(ascending));
    b.items = merged;
}

template <class Both>
void assignCopy(Both& b) {
    List const copy(b.list);
    b.list = copy;
}

template <class Both>
void clearIfLong(Both& b) {
    if (b.items.size() <= 30) return;
    b.list.clear();
    b.items.clear();
}

template <class Both>
constexpr Operation<Both> OPERATIONS[] = {
    {"insert at the front", 1, insertFront},
    {"insert at the back", 1, insertBack},
    {"insert behind", 1, insertAfter},
    {"insert before", 1, insertBefore},
    {"remove", 2, remove},
    {"take the first", 1, takeFirst},
    {"reverse", 1, reverse},
    {"sort", 1, [](Both& b) { b.sort(b.below(2) == 0); }},
    {"merge", 1, merge},
    {"assign a copy", 1, assignCopy},
    {"clear", 1, clearIfLong},
};

} // namespace sng_list

#endif
