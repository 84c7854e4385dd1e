#include "tests/containers/item_list.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using namespace ZOR_Basis;

TEST(SngListSort, sorts_both_ways_and_keeps_equal_values_in_order) {
    struct Case {
        Row row;
        std::vector<Item> items;
        char const *ascending, *descending;
    };
    for (Case const& c : {
             Case{{}, {}, "", ""}, Case{{}, {{1, 0}}, "1 ", "1 "}, Case{{}, {{2, 0}, {1, 0}}, "1 2 ", "2 1 "},
             Case{{}, {{1, 0}, {2, 0}}, "1 2 ", "2 1 "}, Case{{}, {{1, 1}, {1, 2}, {1, 3}}, "1a 1b 1c ", "1a 1b 1c "},
             Case{{}, {{1, 1}, {1, 2}, {1, 3}, {1, 4}}, "1a 1b 1c 1d ", "1a 1b 1c 1d "},
             Case{{}, {{2, 1}, {1, 1}, {2, 2}, {1, 2}}, "1a 1b 2a 2b ", "2a 2b 1a 1b "},
             Case{{}, {{3, 0}, {1, 1}, {1, 2}}, "1a 1b 3 ", "3 1a 1b "}, // two equal units as a part of a list stay
         }) {
        SCOPED_TRACE(c.row);
        List list = listOf(c.items);
        list.sort(true);
        EXPECT_EQ(shown(list), c.ascending);
        list = listOf(c.items);
        list.sort(false);
        EXPECT_EQ(shown(list), c.descending);
    }
}

TEST(SngListSort, Kept_list_01_swaps_two_equal_values) {
    for (bool ascending : {true, false}) {
        List list = listOf({{1, 1}, {1, 2}});
        list.sort(ascending);
        EXPECT_EQ(shown(list), "1b 1a ");
    }
}

TEST(SngListMerge, interleaves_sorted_lists) {
    struct Case {
        Row row;
        std::vector<Item> mine, theirs;
        bool ascending;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, {{1, 0}, {3, 0}}, {{2, 0}, {4, 0}}, true, "1 2 3 4 "},
             Case{{}, {{2, 0}, {4, 0}}, {{1, 0}, {3, 0}}, true, "1 2 3 4 "},
             Case{{}, {{4, 0}, {2, 0}}, {{3, 0}, {1, 0}}, false, "4 3 2 1 "},
             Case{{}, {}, {{1, 0}, {2, 0}}, true, "1 2 "},
             Case{{}, {{1, 0}, {2, 0}}, {}, true, "1 2 "},
             Case{{}, {}, {}, true, ""},
             Case{{}, {{1, 0}}, {{2, 0}, {3, 0}}, true, "1 2 3 "},
             Case{{}, {{5, 0}}, {{2, 0}, {3, 0}}, true, "2 3 5 "},
         }) {
        SCOPED_TRACE(c.row);
        List mine = listOf(c.mine);
        List theirs = listOf(c.theirs);
        mine.merge(theirs, c.ascending);
        EXPECT_EQ(shown(mine), c.expected);
        EXPECT_EQ(shown(theirs), "");
        EXPECT_EQ(theirs.size(), 0u);
        mine.insertBack(Item{9, 0});
        EXPECT_EQ(shown(mine), c.expected + std::string("9 ")) << "the tail is right";
    }
}

TEST(SngListMerge, Kept_list_02_puts_the_other_list_first_among_equals) {
    List mine = listOf({{1, 1}, {2, 1}});
    List theirs = listOf({{1, 2}, {2, 2}});
    mine.merge(theirs, true);
    EXPECT_EQ(shown(mine), "1b 1a 2b 2a ");
    mine.merge(mine, true);
    EXPECT_EQ(shown(mine), "1b 1a 2b 2a ");
}

TEST(SngListComp, is_strict_both_ways) {
    List list = listOf({{1, 0}, {2, 0}});
    List::Unit* const one = list.first();
    List::Unit* const two = list.last();
    EXPECT_TRUE(List::comp(one, two, true) && !List::comp(two, one, true) && !List::comp(one, one, true));
    EXPECT_TRUE(List::comp(two, one, false) && !List::comp(one, two, false) && !List::comp(one, one, false));
}
