#include "tools/zbtool/utf8.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

using namespace zbtool;

namespace {

struct LengthCase {
    Row row;
    std::string_view text;
    std::size_t length;
};

TEST(Utf8, tells_valid_characters_from_other_bytes) {
    LengthCase const cases[] = {
        {{}, "", 0},
        {{}, "a\xFF", 1},
        {{}, {"\0", 1}, 1},
        {{}, "\x7F", 1},
        {{}, "\x80", 0},
        {{}, "\xC1\xBF", 0},
        {{}, "\xC2\x80", 2},
        {{}, "\xC2", 0},
        {{}, "\xC2\x7F", 0},
        {{}, "\xE0\x9F\xBF", 0},
        {{}, "\xE0\xA0\x80", 3},
        {{}, "\xED\x9F\xBF", 3},
        {{}, "\xED\xA0\x80", 0},
        {{}, "\xEF\xBF\xBF", 3},
        {{}, "\xEF\xBF", 0},
        {{}, "\xF0\x8F\xBF\xBF", 0},
        {{}, "\xF0\x90\x80\x80", 4},
        {{}, "\xF4\x8F\xBF\xBF", 4},
        {{}, "\xF4\x90\x80\x80", 0},
        {{}, "\xF5\x80\x80\x80", 0},
        {{}, "\xF0\x90\x80\xC0", 0},
    };
    for (LengthCase const& c : cases) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(utf8Length(c.text), c.length);
    }
    EXPECT_TRUE(isUtf8("caf\xC3\xA9"));
    EXPECT_FALSE(isUtf8("caf\xC3"));
}

TEST(Utf8, tells_how_much_of_a_character_is_at_the_end) {
    LengthCase const cases[] = {
        {{}, "", 0},
        {{}, "a", 0},
        {{}, "\xC3\xA9", 0},
        {{}, "\xC3", 1},
        {{}, "a\xE2\x82", 2},
        {{}, "\xE2\x82\xAC", 0},
        {{}, "\xF0\x9F\x98", 3},
        {{}, "\xF0\x9F\x98\x80", 0},
        {{}, "\x80\x80\x80\x80", 0},
        {{}, "\xFF", 0},
        {{},
         "\xC3"
         "a",
         0},
    };
    for (LengthCase const& c : cases) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(unfinishedLength(c.text), c.length);
    }
}

TEST(Utf8, appends_what_it_reads_back_as_one_character) {
    for (std::uint32_t codePoint : {0u, 0x7Fu, 0x80u, 0x7FFu, 0x800u, 0xFFFFu, 0x10000u, 0x10FFFFu}) {
        SCOPED_TRACE(codePoint);
        std::string text;
        appendUtf8(text, codePoint);
        EXPECT_EQ(utf8Length(text), text.size());
    }
    std::string text = "x";
    appendUtf8(text, 0x20AC);
    EXPECT_EQ(text, "x\xE2\x82\xAC");
}

} // namespace
