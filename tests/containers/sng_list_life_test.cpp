// How a list copies, moves and deletes its units.

#include "tests/containers/item_list.h"

#include <gtest/gtest.h>

#include <new>
#include <type_traits>
#include <utility>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// A value that can be copied only a limited number of times.
struct Scarce {
    Scarce() { ++living; }
    Scarce(Scarce const&) {
        if (left == 0) throw std::bad_alloc();
        --left;
        ++living;
    }
    ~Scarce() { --living; }

    static int left;
    static int living;
};
int Scarce::left = 0;
int Scarce::living = 0;

/// A value that records its destruction.
struct Teller {
    explicit Teller(int n) : number(n) {}
    Teller(Teller const&) = default;
    Teller& operator=(Teller const&) = default;
    ~Teller() { told.push_back(number); }

    int number;
    static std::vector<int> told;
};
std::vector<int> Teller::told;

void fill(SngList<Teller>& list) {
    for (int i : {3, 1, 2}) list.insertBack(Teller(i));
    Teller::told.clear();
}

} // namespace

TEST(SngList, deletes_its_units) {
    {
        List list = listOf({{1, 0}, {2, 0}, {3, 0}});
        List const copy(list);
        EXPECT_EQ(Item::living, 6);
        list.clear();
        EXPECT_EQ(Item::living, 3);
        EXPECT_EQ(shown(list), "");
        EXPECT_EQ(list.first(), nullptr);
        EXPECT_EQ(list.last(), nullptr);
        list.insertBack(Item{1, 0});
        EXPECT_EQ(shown(list), "1 ");
    }
    EXPECT_EQ(Item::living, 0);
}

TEST(SngList, deletes_its_units_from_the_front) {
    SngList<Teller> list;
    fill(list);
    list.clear();
    EXPECT_EQ(Teller::told, (std::vector<int>{3, 1, 2}));
    fill(list);
    list.reverse();
    list.insertFront(new SngList<Teller>::Unit{nullptr, Teller(4)});
    Teller::told.clear();
    list.clear();
    EXPECT_EQ(Teller::told, (std::vector<int>{4, 2, 1, 3})) << "as they stand, not as they came";
    {
        SngList<Teller> other;
        fill(other);
    }
    EXPECT_EQ(Teller::told, (std::vector<int>{3, 1, 2})) << "at the end of its life";
    fill(list);
    list = SngList<Teller>();
    EXPECT_EQ(Teller::told, (std::vector<int>{3, 1, 2})) << "before others are assigned";
}

TEST(SngList, copies_values_into_units_of_its_own) {
    List list = listOf({{1, 0}, {2, 0}});
    List copy(list);
    copy.first()->value.key = 9;
    EXPECT_EQ(shown(list), "1 2 ");
    EXPECT_EQ(shown(copy), "9 2 ");
    copy = list;
    EXPECT_EQ(shown(copy), "1 2 ");
    List const& self = copy;
    copy = self;
    EXPECT_EQ(shown(copy), "1 2 ");
    copy = List();
    EXPECT_EQ(shown(copy), "");
}

TEST(SngList, leaves_nothing_behind_when_a_value_cannot_be_copied) {
    {
        SngList<Scarce> list;
        Scarce const value;
        Scarce::left = 3;
        for (int i = 0; i < 3; ++i) list.insertBack(value);
        Scarce::left = 2;
        EXPECT_THROW(SngList<Scarce>{list}, std::bad_alloc);
        EXPECT_EQ(Scarce::living, 4);
        SngList<Scarce> other;
        Scarce::left = 1;
        EXPECT_THROW(other = list, std::bad_alloc);
        EXPECT_EQ(other.size(), 0u);
        EXPECT_EQ(Scarce::living, 4);
        EXPECT_THROW(list.insertFront(value), std::bad_alloc);
        EXPECT_TRUE(list.isConsistent());
        EXPECT_EQ(list.size(), 3u);
    }
    EXPECT_EQ(Scarce::living, 0);
}

TEST(SngList, moves_without_a_copy) {
    static_assert(std::is_nothrow_move_constructible_v<List> && std::is_nothrow_move_assignable_v<List>);
    {
        SngList<Scarce> scarce;
        Scarce::left = 1;
        scarce.insertBack(Scarce());
        SngList<Scarce> moved(std::move(scarce));
        scarce = std::move(moved);
        EXPECT_EQ(scarce.size(), 1u) << "no copy was left to make";
    }
    EXPECT_EQ(Scarce::living, 0);
}

TEST(SngList, moves_its_units_and_leaves_an_empty_list) {
    List source = listOf({{1, 0}, {2, 0}, {3, 0}});
    List::Unit* const first = source.first();
    List taken(std::move(source));
    EXPECT_EQ(taken.first(), first);
    EXPECT_EQ(shown(taken), "1 2 3 ");
    EXPECT_EQ(shown(source), ""); // NOLINT(bugprone-use-after-move)
    source.insertBack(Item{9, 0});
    EXPECT_EQ(shown(source), "9 ") << "the moved-from list is an empty one";
    EXPECT_EQ(source.last(), source.first());
    int const living = Item::living;
    source = std::move(taken);
    EXPECT_EQ(Item::living, living - 1) << "what was there before is deleted first";
    EXPECT_EQ(source.first(), first);
    EXPECT_EQ(shown(source), "1 2 3 ");
    EXPECT_EQ(shown(taken), ""); // NOLINT(bugprone-use-after-move)
    source.insertBack(Item{4, 0});
    EXPECT_EQ(shown(source), "1 2 3 4 ");
    List& self = source;
    source = std::move(self);
    EXPECT_EQ(shown(source), "1 2 3 4 ");
    source = listOf({{5, 0}});
    EXPECT_EQ(shown(source), "5 ");
}
