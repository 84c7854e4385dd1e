// A locale of another decimal point, made for the test.

#include "tests/log/line_check.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <clocale>
#include <cstdlib>
#include <string>

TEST(LineTextPosix, has_the_decimal_point_of_the_locale) {
    Scratch const scratch;
    std::string const make = "localedef -f UTF-8 -i de_DE " + scratch / "zb_comma" + " 2>/dev/null";
    ASSERT_EQ(std::system(make.c_str()), 0) << "the package `locales` has the sources";
    ::setenv("LOCPATH", scratch.path().c_str(), 1);
    ASSERT_NE(std::setlocale(LC_NUMERIC, "zb_comma"), nullptr);
    Written const written = writtenWith(ROOM, "%.2f and %e", 1.5, 1.5);
    Written const quick = writtenWith(ROOM, "%.2f", -1234.5);
    std::string const expected = printed(ROOM, "%.2f and %e", 1.5, 1.5);
    std::setlocale(LC_NUMERIC, "C");
    ::unsetenv("LOCPATH");
    EXPECT_EQ(written.ours, expected);
    EXPECT_EQ(written.ours, "1,50 and 1,500000e+00");
    EXPECT_TRUE(quick.quickly);
    EXPECT_EQ(quick.ours, "-1234,50");
}
