#include "zor_basis/text/wstr.h"

#include "tests/support/table.h"
#include "tests/text/string_kinds.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

static_assert(sizeof(WChar) == 2 && WStr::SizeWChar == 2);
static_assert(std::is_trivially_copyable_v<WStr>);

namespace {

template <class A, class B>
concept HasLessOrEqual = requires(A const& a, B const& b) {
    a <= b;
};
template <class A, class B>
concept HasLess = requires(A const& a, B const& b) {
    a < b;
};

static_assert(HasLess<WStr, WStr> && !HasLessOrEqual<WStr, WStr>);
static_assert(!HasLess<WStr, WChar const*> && !HasLess<WChar const*, WStr> && !HasLessOrEqual<WChar const*, WStr>);

using WText = std::basic_string<WChar>;

} // namespace

TEST(WStr, breathes) {
    WStr const view(ZB_W("tray1"));
    EXPECT_EQ(view.size(), 5U);
    EXPECT_EQ(view.first(), WChar('t'));
    EXPECT_EQ(view.last(), WChar('1'));
    EXPECT_EQ(view[1], WChar('r'));
    EXPECT_FALSE(view.empty());
    EXPECT_TRUE(view == ZB_W("tray1"));
}

TEST(WStr, views_what_it_is_given) {
    EXPECT_EQ(WStr().wstr(), WStr::StrEmpty);
    EXPECT_EQ(WStr(nullptr).wstr(), WStr::StrEmpty);
    EXPECT_EQ(WStr().first(), WChar());
    WChar const* text = ZB_W("abcdef");
    EXPECT_EQ(WStr(text, 3).size(), 3U);
    EXPECT_EQ(WStr(text, 0).size(), 0U);
    EXPECT_EQ(static_cast<WChar const*>(WStr(text, 3)), text);
    WText const standard(3, WChar('x'));
    EXPECT_EQ(WStr(standard).size(), 3U);
    EXPECT_EQ(std::basic_string_view<WChar>(WStr(text, 3)), std::basic_string_view<WChar>(text, 3));
}

TEST(WStr, measures_up_to_the_terminator) {
    EXPECT_EQ(WStr::Len(ZB_W("")), 0U);
    EXPECT_EQ(WStr::Len(ZB_W("abc")), 3U);
    EXPECT_EQ(WStr::Len(ZB_W("ab\0c")), 2U);
    EXPECT_EQ(WStr::Len(nullptr), 0U);
    WChar own[] = {0x100, 0x200, 0};
    EXPECT_EQ(WStr::Len(own), 2U) << "a unit with a zero low byte is no terminator";
}

TEST(WStr, the_right_hand_size_decides_how_equality_compares) {
    struct Case {
        Row row;
        WStr left;
        WStr right;
        bool expected;
    };
    for (Case const& c : {
             Case{{}, {ZB_W("abcdef"), 3}, {ZB_W("abc"), 3}, true},
             Case{{}, {ZB_W("abcdef"), 3}, {ZB_W("abc"), 0}, false},
             Case{{}, {ZB_W("abc"), 2}, {ZB_W("abc"), 0}, true},
             Case{{}, {ZB_W("abc"), 0}, {ZB_W("abc"), 3}, false},
             Case{{}, {ZB_W("ab\0x"), 4}, {ZB_W("ab\0y"), 4}, true},
             Case{{}, {ZB_W("abc"), 3}, {ZB_W("abd"), 3}, false},
             Case{{}, {ZB_W(""), 0}, {nullptr, 0}, true},
             Case{{}, {ZB_W("a"), 1}, {nullptr, 0}, false},
         }) {
        SCOPED_TRACE(c.row);
        WText const own(c.left.wstr(), std::max(WStr::Len(c.left), c.left.size()));
        WStr const left(own.c_str(), c.left.size()); // equal literals may be one object, which is always equal
        EXPECT_EQ(left == c.right, c.expected);
        EXPECT_EQ(left != c.right, !c.expected);
        EXPECT_EQ(left.eq(c.right.wstr(), c.right.size()), c.expected);
    }
    EXPECT_TRUE(WStr(ZB_W("abc"), 1) == ZB_W("abc"));
    EXPECT_TRUE(WStr(ZB_W("abc"), 1) != ZB_W("a"));
    EXPECT_TRUE(ZB_W("abc") == WStr(ZB_W("abc"), 1));
    WChar const* same = ZB_W("abc");
    EXPECT_TRUE(WStr(same, 1) == WStr(same, 3));
}

TEST(WStr, is_compared_from_the_other_side_too) {
    WChar const text[] = ZB_W("abcdef");
    WStr const part(text, 3);
    EXPECT_TRUE(ZB_W("abc") == part) << "the size of the right-hand side decides";
    EXPECT_FALSE(ZB_W("abc") != part);
    EXPECT_TRUE(ZB_W("abd") != part);
    EXPECT_FALSE(ZB_W("abcdef") == part);
}

TEST(WStr, equality_reads_nothing_behind_a_terminator) {
    Exact<WChar> const a(WText(2, WChar('a')));
    Exact<WChar> const b(WText(2, WChar('a')));
    EXPECT_TRUE(WStr(a, 100) == WStr(b, 100));
    EXPECT_EQ(WStr(a).compare(b, 100), 0);
}

TEST(WStr, Kept_wide_01_the_order_is_reversed) {
    struct Case {
        Row row;
        WText self;
        WText argument;
        int expected;
    };
    for (Case const& c : {
             Case{{}, {'b'}, {'a'}, -1},
             Case{{}, {'a'}, {'b'}, 1},
             Case{{}, {'a'}, {'a'}, 0},
             Case{{}, {}, {'a'}, 1},
             Case{{}, {'a', 'b'}, {'a'}, -1},
             Case{{}, {WChar(0xFFFF)}, {WChar(0x0001)}, -1},
             Case{{}, {WChar(0x00FF)}, {WChar(0x0100)}, 1},
         }) {
        SCOPED_TRACE(c.row);
        WStr const self(c.self.c_str(), 1);
        WStr const argument(c.argument.c_str(), 1);
        EXPECT_EQ(self.compare(argument), c.expected);
        EXPECT_EQ(self.compare(c.argument.c_str()), c.expected);
        int const some = self.compare(c.argument.c_str(), 5);
        EXPECT_EQ((some > 0) - (some < 0), c.expected);
        EXPECT_EQ(self < argument, c.expected < 0);
        EXPECT_EQ(self > argument, c.expected > 0);
    }
    EXPECT_EQ(WStr(ZB_W("b")).compare(nullptr), -1) << "null counts as the empty text";
    EXPECT_EQ(WStr(ZB_W("abc")).compare(ZB_W("abx"), 2), 0);
    EXPECT_EQ(WStr(ZB_W("abc")).compare(ZB_W("xyz"), 0), 0);
}

TEST(WStr, finds_the_first_occurrence) {
    WStr const view(ZB_W("aab.aac"));
    EXPECT_EQ(view.find(ZB_W("aac")), view.wstr() + 4);
    EXPECT_EQ(view.find(WStr(ZB_W("ab"))), view.wstr() + 1);
    EXPECT_EQ(view.find(ZB_W("")), view.wstr());
    EXPECT_EQ(view.find(ZB_W("x")), nullptr);
    EXPECT_EQ(view.find(ZB_W("aacc")), nullptr);
    EXPECT_EQ(view.find(static_cast<WChar const*>(nullptr)), nullptr);
    EXPECT_EQ(WStr().find(ZB_W("")), WStr::StrEmpty);
}

TEST(WStr, changes_case_up_to_the_terminator) {
    WChar text[] = {'a', 'B', '1', 0, 'c', 0};
    WStr::toUpper(text);
    EXPECT_TRUE(WStr(text) == ZB_W("AB1"));
    EXPECT_EQ(text[4], WChar('c'));
    WStr::toLower(text);
    EXPECT_TRUE(WStr(text) == ZB_W("ab1"));
    WChar pair[] = {0xD83D, 0xDE00, 0};
    WStr::toUpper(pair);
    EXPECT_EQ(pair[0], WChar(0xD83D));
    EXPECT_EQ(pair[1], WChar(0xDE00));
}
