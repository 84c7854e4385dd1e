// The sibling is text_mode_posix_test.cpp.

#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

TEST(HostFileTextModeWin, stores_line_ends_as_two_characters_and_counts_the_callers) {
    Scratch const scratch;
    xos_File const file = xos_FileOpen((scratch / "f").c_str(), 0x14 | 0x20);
    EXPECT_EQ(xos_FileWriteEx(file, "a\nbc\n\nd", 7, 0, 0), 7U);
    EXPECT_EQ(xos_FileTellEx(file, 0), 10);
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
    EXPECT_EQ(textOf(scratch / "f"), "a\r\nbc\r\n\r\nd");
}

TEST(HostFileTextModeWin, reads_two_character_line_ends_as_one) {
    Scratch const scratch;
    put(scratch / "f", "a\r\nb\rc\n\r\r\nd\r");
    xos_File const file = xos_FileOpen((scratch / "f").c_str(), 0x02 | 0x20);
    char line[16];
    EXPECT_STREQ(xos_FileGetsEx(file, line, sizeof line, 0), "a\n");
    EXPECT_EQ(xos_FileTellEx(file, 0), 3);
    EXPECT_STREQ(xos_FileGetsEx(file, line, sizeof line, 0), "b\rc\n");
    char rest[16] = {};
    EXPECT_EQ(xos_FileReadEx(file, rest, 15, 0, 0), 4U);
    EXPECT_STREQ(rest, "\r\nd\r");
    EXPECT_EQ(xos_FileGetsEx(file, line, sizeof line, 0), nullptr);
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
}

TEST(HostFileTextModeWin, finds_a_line_end_that_the_read_ahead_has_cut) {
    Scratch const scratch;
    std::string const before(32 * 1024 - 1, 'x');
    put(scratch / "f", before + "\r\ny");
    xos_File const file = xos_FileOpen((scratch / "f").c_str(), 0x02 | 0x20);
    std::string text(40'000, '\0');
    text.resize(xos_FileReadEx(file, text.data(), text.size(), 0, 0));
    EXPECT_EQ(text, before + "\ny");
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
}
