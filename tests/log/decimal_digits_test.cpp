#include "basis/log/decimal_digits.h"

#include <gtest/gtest.h>

#include <limits>
#include <string>

using namespace ZOR_Basis;

namespace {

std::string written(std::uint64_t number) {
    char text[24] = {};
    return {text, writeDecimal(text, number)};
}

} // namespace

TEST(DecimalDigits, are_as_many_as_the_number_has) {
    EXPECT_EQ(decimalDigits(0), 1);
    std::uint64_t power = 1;
    for (int digits = 1; digits <= 20; ++digits, power *= 10) {
        EXPECT_EQ(decimalDigits(power), digits);
        if (power > 1) { EXPECT_EQ(decimalDigits(power - 1), digits - 1); }
        EXPECT_EQ(decimalDigits(power + power / 2), digits);
    }
    EXPECT_EQ(decimalDigits(std::numeric_limits<std::uint64_t>::max()), 20);
}

TEST(DecimalDigits, are_written_like_those_of_the_standard_library) {
    for (std::uint64_t number : {0ull, 7ull, 10ull, 99ull, 100ull, 12'345ull, 4'294'967'296ull}) {
        EXPECT_EQ(written(number), std::to_string(number));
    }
    for (unsigned shift = 0; shift < 64; ++shift) {
        std::uint64_t const number = std::numeric_limits<std::uint64_t>::max() >> shift;
        EXPECT_EQ(written(number), std::to_string(number));
    }
}

TEST(DecimalDigits, are_the_last_ones_where_fewer_are_written_and_zeros_where_more_are) {
    char text[8] = "#######";
    EXPECT_EQ(writeDigits(text, 12'345, 3), text + 3);
    EXPECT_STREQ(text, "345####");
    EXPECT_EQ(writeDigits(text, 42, 5), text + 5);
    EXPECT_STREQ(text, "00042##");
    EXPECT_EQ(writeDigits(text, 9, 0), text);
    EXPECT_STREQ(text, "00042##");
}
