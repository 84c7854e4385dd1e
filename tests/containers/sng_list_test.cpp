#include "tests/containers/item_list.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>
#include <string>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

TEST(SngList, breathes) {
    List list;
    EXPECT_EQ(list.size(), 0u);
    EXPECT_EQ(list.first(), nullptr);
    EXPECT_EQ(list.last(), nullptr);
    EXPECT_TRUE(list.begin() == list.end());
    list.insertFront(Item{2, 0});
    list.insertFront(Item{1, 0});
    list.insertBack(Item{3, 0});
    EXPECT_EQ(shown(list), "1 2 3 ");
    EXPECT_EQ(list.first()->value.key, 1);
    EXPECT_EQ(list.last()->value.key, 3);
    EXPECT_EQ(list.begin()->key, 1);
    EXPECT_EQ(list.begin().unit(), list.first());
}

TEST(SngList, is_walked_by_the_standard_algorithms) {
    SngList<int> list;
    for (int value : {3, 1, 2}) list.insertBack(value);
    EXPECT_EQ(std::distance(list.begin(), list.end()), 3);
    EXPECT_EQ(std::vector<int>(list.begin(), list.end()), (std::vector<int>{3, 1, 2}));
    auto place = std::find(list.begin(), list.end(), 1);
    EXPECT_EQ(*place++, 1);
    EXPECT_EQ(*place, 2);
    list.remove(place);
    EXPECT_EQ(std::vector<int>(list.begin(), list.end()), (std::vector<int>{3, 1}));
}

TEST(SngList, adopts_a_chain) {
    auto* const third = new List::Unit{nullptr, {3, 0}};
    auto* const second = new List::Unit{third, {2, 0}};
    auto* const first = new List::Unit{second, {1, 0}};
    List list(first, third, 3);
    EXPECT_EQ(shown(list), "1 2 3 ");
    list.insertBack(Item{4, 0});
    EXPECT_EQ(shown(list), "1 2 3 4 ");
    auto* const unit = new List::Unit{first, {0, 0}}; // whatever its link says
    list.insertBack(unit);
    EXPECT_EQ(shown(list), "1 2 3 4 0 ");
}

TEST(SngList, is_walked_without_being_changed) {
    List list = listOf({{3, 0}, {1, 0}, {2, 0}});
    List const& constant = list;
    std::string found;
    for (Item const& item : constant) found += std::to_string(item.key);
    EXPECT_EQ(found, "312");
    static_assert(std::forward_iterator<List::const_iterator> && std::forward_iterator<List::iterator>);
    static_assert(std::is_same_v<decltype(*constant.begin()), Item const&>);
    static_assert(std::is_same_v<decltype(*list.cbegin()), Item const&>);
    static_assert(std::is_convertible_v<List::iterator, List::const_iterator>);
    static_assert(!std::is_convertible_v<List::const_iterator, List::iterator>);
    List::const_iterator place = list.begin();
    EXPECT_EQ(place.unit(), list.first());
    EXPECT_EQ(place++->key, 3);
    EXPECT_EQ(place->key, 1);
    EXPECT_EQ((++place)->key, 2);
    EXPECT_TRUE(++place == constant.end() && place == list.cend() && place != list.cbegin());
    EXPECT_TRUE(list.begin() == list.cbegin() && list.cend() == list.end());
    EXPECT_EQ(std::distance(constant.begin(), constant.end()), 3);
    EXPECT_TRUE(List().cbegin() == List().cend());
}

TEST(SngList, tells_whether_it_is_empty) {
    List list;
    EXPECT_TRUE(list.empty());
    list.insertBack(Item{1, 0});
    EXPECT_FALSE(list.empty());
    list.removeFirst();
    EXPECT_TRUE(list.empty());
}

TEST(SngList, inserts_behind_an_iterator) {
    struct Case {
        Row row;
        int place; // as many as there are: the end
        char const *expected, *current;
    };
    for (Case const& c : {Case{{}, 0, "1 9 2 3 ", "1"}, Case{{}, 1, "1 2 9 3 ", "2"}, Case{{}, 2, "1 2 3 9 ", "3"},
                          Case{{}, 3, "1 2 3 9 ", ""}}) {
        SCOPED_TRACE(c.row);
        List list = listOf({{1, 0}, {2, 0}, {3, 0}});
        List::iterator place = placeOf(list, c.place);
        list.insertAfter(Item{9, 0}, place);
        EXPECT_EQ(shown(list), c.expected);
        EXPECT_EQ(place.unit() != nullptr ? std::to_string(place->key) : "", c.current);
    }
    List empty;
    List::iterator nowhere = empty.end();
    empty.insertAfter(new List::Unit{nullptr, {5, 0}}, nowhere);
    EXPECT_EQ(shown(empty), "5 ");
}

TEST(SngList, inserts_before_an_iterator_again_and_again) {
    struct Case {
        Row row;
        int place;
        char const* expected;
    };
    for (Case const& c :
         {Case{{}, 0, "8 9 1 2 3 "}, Case{{}, 1, "1 8 9 2 3 "}, Case{{}, 2, "1 2 8 9 3 "}, Case{{}, 3, "1 2 3 8 9 "}}) {
        SCOPED_TRACE(c.row);
        List list = listOf({{1, 0}, {2, 0}, {3, 0}});
        List::iterator place = placeOf(list, c.place);
        list.insertBefore(Item{8, 0}, place);
        list.insertBefore(new List::Unit{nullptr, {9, 0}}, place);
        EXPECT_EQ(shown(list), c.expected);
        if (c.place == 3) continue;
        list.remove(place); // the unit before it is known
        EXPECT_EQ(list.size(), 4u);
        EXPECT_TRUE(list.isConsistent());
    }
}

TEST(SngList, removes_at_an_iterator_with_the_tail_always_right) {
    struct Case {
        Row row;
        int place;
        char const *expected, *next;
    };
    for (Case const& c :
         {Case{{}, 0, "2 3 ", "2"}, Case{{}, 1, "1 3 ", "3"}, Case{{}, 2, "1 2 ", ""}, Case{{}, 3, "1 2 3 ", ""}}) {
        SCOPED_TRACE(c.row);
        List list = listOf({{1, 0}, {2, 0}, {3, 0}});
        List::iterator place = placeOf(list, c.place);
        list.remove(place);
        EXPECT_EQ(shown(list), c.expected);
        EXPECT_EQ(place.unit() != nullptr ? std::to_string(place->key) : "", c.next);
        list.insertBack(Item{7, 0});
        EXPECT_EQ(shown(list), c.expected + std::string("7 "));
    }
    List list = listOf({{1, 0}, {2, 0}, {3, 0}, {4, 0}});
    for (List::iterator place = list.begin(); place != list.end();) {
        if (place->key % 2 == 0) {
            list.remove(place);
        } else {
            ++place;
        }
    }
    EXPECT_EQ(shown(list), "1 3 ");
}

TEST(SngList, takes_units_out_with_their_values) {
    List list = listOf({{1, 0}, {2, 0}, {3, 0}});
    List::iterator place = placeOf(list, 1);
    List::Unit* const unit = list.take(place);
    EXPECT_EQ(unit->value.key, 2);
    EXPECT_EQ(unit->next, nullptr);
    EXPECT_EQ(place->key, 3);
    EXPECT_EQ(shown(list), "1 3 ");
    list.insertFront(unit);
    EXPECT_EQ(shown(list), "2 1 3 ");
    List::iterator end = list.end();
    EXPECT_EQ(list.take(end), nullptr);
    List::Unit* const first = list.takeFirst();
    EXPECT_EQ(first->value.key, 2);
    delete first;
    list.removeFirst();
    list.removeFirst();
    EXPECT_EQ(shown(list), "");
    EXPECT_EQ(list.last(), nullptr);
    list.removeFirst();
    EXPECT_EQ(list.takeFirst(), nullptr);
    EXPECT_EQ(shown(list), "");
}

TEST(SngList, is_reversed_in_place) {
    for (int count : {0, 1, 2, 3, 10}) {
        List list;
        std::string expected;
        for (int i = 0; i < count; ++i) {
            list.insertBack(Item{i, 0});
            expected = std::to_string(i) + " " + expected;
        }
        List::Unit* const first = list.first();
        List::Unit* const last = list.last();
        list.reverse();
        EXPECT_EQ(shown(list), expected);
        EXPECT_EQ(list.first(), last);
        EXPECT_EQ(list.last(), first);
    }
}
