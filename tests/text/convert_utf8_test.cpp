#include "tests/text/convert_check.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;
using reference::WideText;

// ---- UTF-8 to wide --------------------------------------------------------------------------------------------------

namespace {

struct Bound {
    Row row;
    char const* text;
    WideText expected;
};

Bound const BOUNDS[] = {
    {{}, "\x01", {0x01}},
    {{}, "\x7F", {0x7F}},
    {{}, "\xC2\x80", {0x80}},
    {{}, "\xDF\xBF", {0x7FF}},
    {{}, "\xE0\xA0\x80", {0x800}},
    {{}, "\xED\x9F\xBF", {0xD7FF}},
    {{}, "\xEE\x80\x80", {0xE000}},
    {{}, "\xEF\xBF\xBF", {0xFFFF}},
    {{}, "\xF0\x90\x80\x80", {0xD800, 0xDC00}},
    {{}, "\xF4\x8F\xBF\xBF", {0xDBFF, 0xDFFF}},
    {{},
     "\xEF\xBB\xBF"
     "a",
     {0xFEFF, 'a'}},
};

} // namespace

TEST(ConvertUtf8ToWide, accepts_the_bounds_of_every_length) {
    for (Bound const& c : BOUNDS) {
        SCOPED_TRACE(c.row);
        for (std::string const& around : {std::string(), std::string("ab"), std::string(40, 'z')}) {
            WBStr wide = filled<WBStr>();
            EXPECT_TRUE(Convert::Utf8ToWide(around + c.text + around, wide));
            WideText const side(around.begin(), around.end());
            EXPECT_EQ(unitsOf(wide), side + c.expected + side);
        }
    }
}

namespace {

struct Invalid {
    Row row;
    char const* text;
};

Invalid const INVALID_TEXTS[] = {
    {{}, "\x80"},         // a continuation alone
    {{}, "\xBF"},         //
    {{}, "\xC3"},         // cut after the first byte
    {{}, "\xE2\x82"},     // cut after the second
    {{}, "\xE2"},         //
    {{}, "\xF0\x9F\x98"}, // cut after the third
    {{}, "\xF0\x9F"},     //
    {{}, "\xF0"},         //
    {{},
     "\xC3"
     "a"}, // a letter where a continuation belongs
    {{},
     "\xE2\x82"
     "a"}, //
    {{},
     "\xE2"
     "a\x82"}, //
    {{},
     "\xF0\x9F\x98"
     "a"}, //
    {{},
     "\xF0\x9F"
     "a\x80"}, //
    {{},
     "\xF0"
     "a\x98\x80"},                    //
    {{}, "\xC3\xC3\xA4"},             // a start where a continuation belongs
    {{}, "\xC0\x80"},                 // overlong
    {{}, "\xC0\xAF"},                 //
    {{}, "\xC1\xBF"},                 //
    {{}, "\xE0\x80\x80"},             //
    {{}, "\xE0\x9F\xBF"},             //
    {{}, "\xF0\x80\x80\x80"},         //
    {{}, "\xF0\x8F\xBF\xBF"},         //
    {{}, "\xED\xA0\x80"},             // a surrogate
    {{}, "\xED\xBF\xBF"},             //
    {{}, "\xED\xA0\xBD\xED\xB8\x80"}, // a pair of them
    {{}, "\xF4\x90\x80\x80"},         // above U+10FFFF
    {{}, "\xF5\x80\x80\x80"},         //
    {{}, "\xF7\xBF\xBF\xBF"},         //
    {{}, "\xF8\x88\x80\x80\x80"},     // no such start
    {{}, "\xFC\x84\x80\x80\x80\x80"}, //
    {{}, "\xFE"},                     //
    {{}, "\xFF"},                     //
};

} // namespace

TEST(ConvertUtf8ToWide, refuses_every_kind_of_invalid_text_and_leaves_nothing) {
    for (Invalid const& c : INVALID_TEXTS) {
        SCOPED_TRACE(c.row);
        for (std::string const& around : {std::string(), std::string("ab"), std::string(40, 'z'), std::string(400, 'q'),
                                          std::string("\xE2\x82\xAC\xE2\x82\xAC\xE2\x82\xAC\xE2\x82\xAC")}) {
            WBStr wide = filled<WBStr>();
            EXPECT_FALSE(Convert::Utf8ToWide(around + c.text, wide));
            EXPECT_EQ(wide.size(), 0u);
            EXPECT_EQ(wide.wstr()[0], 0);
            EXPECT_FALSE(Convert::Utf8ToWide(around + c.text + around, wide));
            EXPECT_EQ(wide.size(), 0u);
        }
    }
}

TEST(ConvertUtf8ToWide, never_reads_past_the_given_length) {
    // The length ends after the first, second and third byte of four; the rest of the character follows in memory.
    char const text[] = "ab\xF0\x9F\x98\x80";
    WBStr wide;
    for (std::uint64_t length : {3u, 4u, 5u}) EXPECT_FALSE(Convert::Utf8ToWide(text, wide, length)) << length;
    EXPECT_TRUE(Convert::Utf8ToWide(text, wide, 2));
    EXPECT_EQ(unitsOf(wide), ZB_W("ab"));
    EXPECT_TRUE(Convert::Utf8ToWide(text, wide, 6));
    EXPECT_EQ(wide.size(), 4u);
}

TEST(ConvertUtf8ToWide, takes_a_zero_inside_a_given_length_as_text) {
    WBStr wide;
    EXPECT_TRUE(Convert::Utf8ToWide("a\0b", wide, 3));
    EXPECT_EQ(unitsOf(wide), WideText(ZB_W("a\0b"), 3));
    EXPECT_TRUE(Convert::Utf8ToWide("\0ab", wide, 3));
    EXPECT_EQ(unitsOf(wide), WideText(ZB_W("\0ab"), 3));
}

// ---- wide to UTF-8 --------------------------------------------------------------------------------------------------

TEST(ConvertWideToUtf8, replaces_unpaired_surrogates) {
    struct Case {
        Row row;
        WideText text;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, {0xD800}, "\xEF\xBF\xBD"},
             Case{{}, {0xDC00}, "\xEF\xBF\xBD"},
             Case{{},
                  {0xDBFF, 'a'},
                  "\xEF\xBF\xBD"
                  "a"},
             Case{{},
                  {'a', 0xDFFF, 'b'},
                  "a\xEF\xBF\xBD"
                  "b"},
             Case{{}, {0xDC00, 0xD800}, "\xEF\xBF\xBD\xEF\xBF\xBD"},
             Case{{}, {0xD800, 0xD800, 0xDC00}, "\xEF\xBF\xBD\xF0\x90\x80\x80"},
             Case{{}, {0xD83D, 0xDE00}, "\xF0\x9F\x98\x80"},
             Case{{}, {0xDBFF, 0xDFFF}, "\xF4\x8F\xBF\xBF"},
             Case{{}, {0x80, 0x7FF, 0x800, 0xFFFF}, "\xC2\x80\xDF\xBF\xE0\xA0\x80\xEF\xBF\xBF"},
         }) {
        SCOPED_TRACE(c.row);
        BufStr<255> narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::WideToUtf8(c.text.c_str(), narrow, c.text.size()));
        EXPECT_EQ(bytesOf(narrow), c.expected);
    }
}

TEST(ConvertWideToUtf8, never_pairs_with_a_unit_past_the_given_length) {
    WideText const text{'a', 0xD83D, 0xDE00};
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToUtf8(text.c_str(), narrow, 2));
    EXPECT_EQ(bytesOf(narrow), "a\xEF\xBF\xBD");
}

TEST(ConvertWideToUtf8, Kept_convert_01_a_zero_inside_a_given_length_ends_the_result) {
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToUtf8(ZB_W("a\0b"), narrow, 3));
    EXPECT_EQ(bytesOf(narrow), "a");
    EXPECT_TRUE(Convert::WideToUtf8(ZB_W("\0b"), narrow, 2));
    EXPECT_EQ(bytesOf(narrow), "");
    EXPECT_TRUE(Convert::WideToLocal(ZB_W("a\0b"), narrow, 3));
    EXPECT_EQ(bytesOf(narrow), "a");
}
