#include "tests/log/comma_locale_posix.h"
#include "tests/log/line_check.h"

#include <gtest/gtest.h>

#include <string>

TEST(LineTextPosix, has_the_decimal_point_of_the_locale) {
    CommaLocale const comma;
    Written const written = writtenWith(ROOM, "%.2f and %e", 1.5, 1.5);
    EXPECT_EQ(written.ours, printed(ROOM, "%.2f and %e", 1.5, 1.5));
    EXPECT_EQ(written.ours, "1,50 and 1,500000e+00");
    Written const quick = writtenWith(ROOM, "%.2f", -1234.5);
    EXPECT_TRUE(quick.quickly);
    EXPECT_EQ(quick.ours, "-1234,50");
}
