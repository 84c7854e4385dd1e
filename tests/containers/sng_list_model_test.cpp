// Applies random operations to a list and to a plain vector.

#include "tests/containers/item_list.h"

#include "tests/support/operations.h"
#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <vector>

using namespace ZOR_Basis;

namespace {

using Items = std::vector<Item>;

auto inOrder(bool ascending) {
    return [ascending](Item const& a, Item const& b) { return ascending ? a.key < b.key : b.key < a.key; };
}

void sortLikeList(Items& items, bool ascending) {
    if (items.size() == 2 && !inOrder(ascending)(items[0], items[1])) {
        std::swap(items[0], items[1]);
    } else if (items.size() != 2) {
        std::stable_sort(items.begin(), items.end(), inOrder(ascending));
    }
}

struct ListBesideVector {
    std::uint64_t below(std::uint64_t bound) { return random() % bound; }
    Item item() { return {static_cast<int>(below(10)), ++tag}; }
    /// An index from the first item to the end.
    std::ptrdiff_t index() { return static_cast<std::ptrdiff_t>(below(items.size() + 1)); }
    std::ptrdiff_t size() const { return static_cast<std::ptrdiff_t>(items.size()); }

    void sort(bool ascending) {
        list.sort(ascending);
        sortLikeList(items, ascending);
    }

    std::mt19937_64 random = randomSource();
    List list;
    Items items;
    int tag = 0;
};

using Both = ListBesideVector;

void insertFront(Both& b) {
    Item const item = b.item();
    b.list.insertFront(item);
    b.items.insert(b.items.begin(), item);
}

void insertBack(Both& b) {
    Item const item = b.item();
    b.list.insertBack(item);
    b.items.push_back(item);
}

void insertAfter(Both& b) {
    Item const item = b.item();
    std::ptrdiff_t const index = b.index();
    List::iterator place = placeOf(b.list, index);
    b.list.insertAfter(item, place);
    b.items.insert(b.items.begin() + std::min(index + 1, b.size()), item);
}

void insertBefore(Both& b) {
    Item const item = b.item();
    std::ptrdiff_t const index = b.index();
    List::iterator place = placeOf(b.list, index);
    b.list.insertBefore(item, place);
    b.items.insert(b.items.begin() + index, item);
}

void remove(Both& b) {
    std::ptrdiff_t const index = b.index();
    List::iterator place = placeOf(b.list, index);
    b.list.remove(place);
    if (index < b.size()) b.items.erase(b.items.begin() + index);
}

void takeFirst(Both& b) {
    delete b.list.takeFirst();
    if (!b.items.empty()) b.items.erase(b.items.begin());
}

void reverse(Both& b) {
    b.list.reverse();
    std::reverse(b.items.begin(), b.items.end());
}

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

void assignCopy(Both& b) {
    List const copy(b.list);
    b.list = copy;
}

void clearIfLong(Both& b) {
    if (b.items.size() <= 30) return;
    b.list.clear();
    b.items.clear();
}

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

} // namespace

TEST(SngListModel, stays_what_a_plain_vector_is) {
    Both b;
    for (std::uint64_t step = randomSteps(100'000); step > 0; --step) {
        Operation<Both> const& operation = drawn(OPERATIONS, b.random);
        operation.act(b);
        ASSERT_TRUE(b.list.isConsistent()) << operation.name;
        ASSERT_EQ(b.list.size(), b.items.size()) << operation.name;
        std::size_t i = 0;
        for (Item const& found : b.list) ASSERT_EQ(found.tag, b.items[i++].tag) << operation.name;
    }
}
