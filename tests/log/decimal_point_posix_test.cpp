#include "basis/log/decimal_point.h"

#include "tests/log/comma_locale_posix.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(DecimalPointPosix, is_the_one_of_the_current_locale) {
    EXPECT_STREQ(decimalPoint(), ".");
    {
        CommaLocale const comma;
        EXPECT_STREQ(decimalPoint(), ",");
    }
    EXPECT_STREQ(decimalPoint(), ".");
}
