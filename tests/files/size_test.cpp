#include <zor_basis/files/size.h>

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <limits>
#include <unordered_map>

using namespace ZOR_Basis;

TEST(Size, breathes) {
    Size size;
    EXPECT_EQ(size.get(), 0u);
    size.set(7);
    EXPECT_EQ(size.get(), 7u);
    EXPECT_EQ(size.val(), 7u);
    EXPECT_EQ(size.hash(), 7u);
}

TEST(Size, Kept_stat_01_takes_the_absolute_value_of_an_int_in_32_bits) {
    struct Case {
        Row row;
        int value;
        std::uint64_t expected;
    };
    for (Case const& c : {
             Case{{}, 0, 0},
             Case{{}, 5, 5},
             Case{{}, -5, 5},
             Case{{}, std::numeric_limits<int>::max(), 0x7FFFFFFF},
             Case{{}, -std::numeric_limits<int>::max(), 0x7FFFFFFF},
             Case{{}, std::numeric_limits<int>::min(), 0xFFFFFFFF80000000},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(Size(c.value).get(), c.expected);
    }
}

TEST(Size, takes_every_other_integer_by_its_value) {
    EXPECT_EQ(Size(5u).get(), 5u);
    EXPECT_EQ(Size(5ul).get(), 5u);
    EXPECT_EQ(Size(5ull).get(), 5u);
    EXPECT_EQ(Size(0xFFFFFFFFu).get(), 0xFFFFFFFFu);
    EXPECT_EQ(Size(std::numeric_limits<std::uint64_t>::max()).get(), std::numeric_limits<std::uint64_t>::max());
    EXPECT_EQ(Size(std::int64_t{1} << 40).get(), std::uint64_t{1} << 40);
}

TEST(Size, compares_values_as_unsigned_numbers) {
    EXPECT_TRUE(Size(0) < Size(1));
    EXPECT_FALSE(Size(1) < Size(1));
    EXPECT_FALSE(Size(std::numeric_limits<std::uint64_t>::max()) < Size(1));
    EXPECT_TRUE(Size(3) == Size(-3));
    EXPECT_FALSE(Size(3) == Size(4));
    EXPECT_TRUE(Size(3) != Size(4));
    EXPECT_FALSE(Size(3) != Size(3));
}

TEST(Size, can_be_a_key) {
    std::unordered_map<Size, int> names;
    names[Size(4)] = 1;
    names[Size(-4)] = 2;
    EXPECT_EQ(names.size(), 1u);
    EXPECT_EQ(names[Size(4u)], 2);
}
