// The sibling is text_mode_win_test.cpp.

#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

TEST(HostFileTextModePosix, changes_nothing_on_Linux) {
    Scratch const scratch;
    xos_File const file = xos_FileOpen((scratch / "f").c_str(), 0x02 | 0x14 | 0x20);
    EXPECT_EQ(xos_FileWriteEx(file, "a\nb\r\n", 5, 0, 0), 5U);
    EXPECT_EQ(xos_FileSeekEx(file, 0, 0, 0), 0);
    char text[8] = {};
    EXPECT_EQ(xos_FileReadEx(file, text, 7, 0, 0), 5U);
    EXPECT_STREQ(text, "a\nb\r\n");
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
    EXPECT_EQ(textOf(scratch / "f"), "a\nb\r\n");
}
