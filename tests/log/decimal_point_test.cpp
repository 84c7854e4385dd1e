#include "basis/log/decimal_point.h"

#include <gtest/gtest.h>

#include <clocale>
#include <string>

using namespace ZOR_Basis;

TEST(DecimalPoint, is_the_one_that_numbers_are_printed_with) {
    // A locale that is not installed changes nothing.
    for (char const* locale : {"C", "de-DE", "de_DE.UTF-8", "C"}) {
        std::setlocale(LC_NUMERIC, locale);
        char number[8];
        std::snprintf(number, sizeof number, "%.1f", 0.5);
        EXPECT_EQ(decimalPoint(), std::string(number + 1, 1)) << locale;
    }
}
