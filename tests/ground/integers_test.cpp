#include <zor_basis/containers/hashing.h>

#include "tests/support/table.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

bool isPrime(std::uint64_t n) {
    for (std::uint64_t d = 2; d * d <= n; ++d) {
        if (n % d == 0) return false;
    }
    return n > 1;
}

} // namespace

TEST(Log2, is_the_floor_of_the_binary_logarithm) {
    struct Case {
        Row row;
        std::uint64_t n, expected;
    };
    for (Case const& c : {Case{{}, 0, 0}, Case{{}, 1, 0}, Case{{}, 2, 1}, Case{{}, 3, 1}, Case{{}, 4, 2},
                          Case{{}, 8, 3}, Case{{}, 9, 3}, Case{{}, 1023, 9}, Case{{}, 1024, 10},
                          Case{{}, 0xFFFFFFFF, 31}, Case{{}, ~std::uint64_t{0}, 63}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(Log2(c.n), c.expected);
    }
}

TEST(Pow2, has_the_largest_prime_not_above_it) {
    EXPECT_EQ(PrimeClsPo2(0), 1u);
    EXPECT_EQ(PrimeClsPo2(4), 13u);
    EXPECT_EQ(PrimeClsPo2(30), 1073741789u);
    for (std::uint64_t i = 0; i <= 30; ++i) {
        EXPECT_EQ(Pow2(i), std::uint64_t{1} << i);
        if (i == 0) continue;
        EXPECT_TRUE(isPrime(PrimeClsPo2(i))) << i;
        for (std::uint64_t n = PrimeClsPo2(i) + 1; n <= Pow2(i); ++n) EXPECT_FALSE(isPrime(n)) << n;
    }
}

TEST(SqrtInt, is_the_floor_of_the_square_root) {
    struct Case {
        Row row;
        std::uint64_t n, expected;
    };
    for (Case const& c :
         {Case{{}, 0, 0}, Case{{}, 1, 1}, Case{{}, 2, 1}, Case{{}, 3, 1}, Case{{}, 4, 2}, Case{{}, 5, 2},
          Case{{}, 24, 4}, Case{{}, 25, 5}, Case{{}, 99, 9}, Case{{}, 100, 10}, Case{{}, 1 << 20, 1 << 10}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(sqrtInt(c.n), c.expected);
    }
    for (std::uint64_t n = 0; n < 100'000; ++n) {
        std::uint64_t const root = sqrtInt(n);
        ASSERT_TRUE(root * root <= n && (root + 1) * (root + 1) > n) << n;
    }
}

TEST(SqrtInt, Kept_hash_02_takes_the_low_32_bits_as_a_signed_number) {
    EXPECT_EQ(sqrtInt((std::uint64_t{1} << 32) + 100), 10u);
    EXPECT_EQ(sqrtInt((std::uint64_t{7} << 40) + 25), 5u);
    for (std::uint64_t n : {std::uint64_t{0x80000000}, std::uint64_t{0xFFFFFFFF}, std::uint64_t{1} << 32}) sqrtInt(n);
}
