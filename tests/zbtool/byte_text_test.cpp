#include "tools/zbtool/byte_text.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

using namespace zbtool;

namespace {

TEST(ByteText, shows_every_byte_by_two_digits_and_reads_them_back) {
    std::string all;
    for (int i = 0; i < 256; ++i) all.push_back(static_cast<char>(i));
    std::string bytes;
    EXPECT_TRUE(readHex(hexText(all), bytes));
    EXPECT_EQ(bytes, all);
    EXPECT_EQ(hexText({"\0\xAB\x7F", 3}), "00ab7f");
    EXPECT_TRUE(readHex("AbCd", bytes));
    EXPECT_EQ(bytes, "\xAB\xCD");
    for (char const* text : {"a", "abc", "0g", "g0", " 1", "0x"}) {
        SCOPED_TRACE(text);
        EXPECT_FALSE(readHex(text, bytes));
    }
}

TEST(ByteText, shows_text_as_it_is_and_all_else_by_its_number) {
    struct Case {
        Row row;
        std::string_view bytes;
        char const* expected;
    };
    Case const cases[] = {
        {{}, "", ""},
        {{}, "caf\xC3\xA9 / x", "caf\xC3\xA9 / x"},
        {{}, "a\\x41", "a\\\\x41"},
        {{}, {"\0\t\x7F", 3}, "\\x00\\x09\\x7f"},
        {{}, "\xFF\xC3", "\\xff\\xc3"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(visibleText(c.bytes), c.expected);
    }
}

TEST(ByteText, takes_from_a_text_what_a_terminal_obeys) {
    struct Case {
        Row row;
        std::string_view bytes;
        char const* name;
        char const* lines;
    };
    Case const cases[] = {
        {{}, "", "", ""},
        {{}, "caf\xC3\xA9 \\ x", "caf\xC3\xA9 \\ x", "caf\xC3\xA9 \\ x"},
        {{}, "a\x1b[2Jb", "a\\x1b[2Jb", "a\\x1b[2Jb"},
        {{}, {"\0\x7F\b", 3}, "\\x00\\x7f\\x08", "\\x00\\x7f\\x08"},
        {{}, "a\n\tb", "a\\x0a\\x09b", "a\n\tb"},
        {{}, "a\r\nb\rc\r", "a\\x0d\\x0ab\\x0dc\\x0d", "a\r\nb\\x0dc\\x0d"},
        // U+009B begins a sequence like ESC [, in UTF-8 and as a byte of its own.
        {{},
         "\xC2\x9B"
         "2J\x9B"
         "2J",
         "\\xc2\\x9b2J\\x9b2J",
         "\\xc2\\x9b2J\\x9b2J"},
        {{}, "\xC2\x80 \xC2\xA0 \xC3\x9B", "\\xc2\\x80 \xC2\xA0 \xC3\x9B", "\\xc2\\x80 \xC2\xA0 \xC3\x9B"},
        {{}, "\xE9\xFF", "\xE9\xFF", "\xE9\xFF"},
    };
    for (Case const& c : cases) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(harmlessText(c.bytes), c.name);
        EXPECT_EQ(harmlessLines(c.bytes), c.lines);
    }
}

} // namespace
