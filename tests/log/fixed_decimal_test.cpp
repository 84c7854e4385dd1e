#include "basis/log/fixed_decimal.h"

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <bit>
#include <cmath>
#include <cstdio>
#include <limits>
#include <string>

using namespace ZOR_Basis;

namespace {

std::string model(double number, int decimals) {
    char text[400];
    std::snprintf(text, sizeof text, "%.*f", decimals, std::fabs(number));
    return text;
}

std::string joined(FixedDecimal const& parts, int decimals) {
    std::string const behind = std::to_string(parts.decimals);
    std::string const whole = std::to_string(parts.whole);
    if (decimals == 0) return whole;
    return whole + "." + std::string(static_cast<std::size_t>(decimals) - behind.size(), '0') + behind;
}

} // namespace

TEST(FixedDecimal, rounds_to_the_nearest_and_from_the_middle_to_the_even) {
    struct Case {
        Row row;
        double number;
        int decimals;
        std::uint64_t whole, behind;
    };
    for (Case const& c : {
             Case{{}, 0.5, 0, 0, 0},
             Case{{}, 1.5, 0, 2, 0},
             Case{{}, 2.5, 0, 2, 0},
             Case{{}, 2.5000000000000004, 0, 3, 0},
             Case{{}, 0.125, 2, 0, 12},
             Case{{}, 0.375, 2, 0, 38},
             Case{{}, -0.375, 2, 0, 38},
             Case{{}, 9.999, 2, 10, 0},
             Case{{}, 0.1, 19, 0, 1000000000000000056},
             Case{{}, 0.99999, 4, 1, 0},
             Case{{}, 0.0, 3, 0, 0},
             Case{{}, 5e-324, 19, 0, 0},
             Case{{}, 7.62939453125e-06, 10, 0, 76294}, // 2^-17: a 5 behind the last
             Case{{}, 9223372036854774784.0, 3, 9223372036854774784u, 0},
         }) {
        SCOPED_TRACE(c.row);
        FixedDecimal parts{};
        ASSERT_TRUE(takeApart(c.number, c.decimals, parts));
        EXPECT_EQ(parts.whole, c.whole);
        EXPECT_EQ(parts.decimals, c.behind);
    }
}

TEST(FixedDecimal, refuses_what_does_not_fit_and_what_is_no_number) {
    constexpr double INFINITE = std::numeric_limits<double>::infinity();
    for (double number : {9223372036854775808.0, -9223372036854775808.0, 1e300, INFINITE, -INFINITE, std::nan("")}) {
        FixedDecimal parts{5, 7};
        EXPECT_FALSE(takeApart(number, 3, parts)) << number;
        EXPECT_EQ(parts.whole, 5u);
        EXPECT_EQ(parts.decimals, 7u);
    }
}

TEST(FixedDecimal, agrees_with_the_runtime_for_any_bits) {
    std::mt19937_64 random = randomSource();
    std::uint64_t const steps = randomSteps(500'000);
    for (std::uint64_t i = 0; i < steps; ++i) {
        std::uint64_t bits = random();
        // Mostly of a magnitude that has digits to print, and often with few bits set, as halfway between two decimals.
        if (i % 8 != 0) bits = (bits & ~(std::uint64_t{0x7FF} << 52)) | (1023 - 140 + random() % 203) << 52;
        if (i % 3 == 0) bits &= ~std::uint64_t{0} << (random() % 53);
        auto const number = std::bit_cast<double>(bits);
        int const decimals = static_cast<int>(random() % (MOST_DECIMALS + 1));
        FixedDecimal parts{};
        bool const fits = std::fabs(number) < 9223372036854775808.0;
        ASSERT_EQ(takeApart(number, decimals, parts), fits) << number;
        if (fits) { ASSERT_EQ(joined(parts, decimals), model(number, decimals)) << number << " " << decimals; }
    }
}
