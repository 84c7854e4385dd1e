#include <zor_basis/text/char_ops.h>

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

using Wide = std::basic_string<WChar>;

Wide widened(std::string const& ascii) { return {ascii.begin(), ascii.end()}; }

/// The index at which `wanted` was found; -1: nowhere.
template <class Char>
std::int64_t placeOfFound(std::basic_string<Char> const& text, std::basic_string<Char> const& wanted) {
    Char const* const found = detail::findText(text.c_str(), wanted.c_str());
    return found != nullptr ? found - text.c_str() : -1;
}

} // namespace

TEST(CharOps, measure_up_to_a_limit) {
    struct Case {
        Row row;
        char const* text;
        std::uint64_t limit, expected;
    };
    for (Case const& c : {
             Case{{}, "", 0, 0},
             Case{{}, "", 5, 0},
             Case{{}, "abc", 0, 0},
             Case{{}, "abc", 2, 2},
             Case{{}, "abc", 3, 3},
             Case{{}, "abc", 4, 3},
             Case{{}, "abc", 1000, 3},
             Case{{}, "ab\0cd", 5, 2},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(detail::textLengthUpTo(c.text, c.limit), c.expected);
        EXPECT_EQ(detail::textLengthUpTo(widened(c.text).c_str(), c.limit), c.expected);
    }
}

TEST(CharOps, find_the_first_occurrence) {
    struct Case {
        Row row;
        char const *text, *wanted;
        std::int64_t expected;
    };
    for (Case const& c : {
             Case{{}, "", "", 0},
             Case{{}, "abc", "", 0},
             Case{{}, "", "a", -1},
             Case{{}, "abcabc", "abc", 0},
             Case{{}, "abcabc", "cab", 2},
             Case{{}, "abcabc", "c", 2},
             Case{{}, "abcabc", "abd", -1},
             Case{{}, "aaab", "aab", 1},
             Case{{}, "abc", "abcd", -1},
             Case{{}, "abc", "C", -1},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(placeOfFound<char>(c.text, c.wanted), c.expected);
        EXPECT_EQ(placeOfFound<WChar>(widened(c.text), widened(c.wanted)), c.expected);
    }
}

TEST(CharOps, find_nothing_in_null_nor_null_in_anything) {
    char const* const none = nullptr;
    WChar const* const wideNone = nullptr;
    EXPECT_EQ(detail::findText("abc", none), nullptr);
    EXPECT_EQ(detail::findText(none, ""), nullptr);
    EXPECT_EQ(detail::findText(ZB_W("abc"), wideNone), nullptr);
    EXPECT_EQ(detail::findText(wideNone, ZB_W("")), nullptr);
}
