// Compares texts of all lengths by each set of vector instructions.

#include "tests/support/vectors.h"
#include "tests/text/naive_order.h"
#include "zor_basis/text/word_ops.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis::detail;

namespace {

struct CompareTextWays : EachVectors {};

bool same(std::string const& a, std::string const& b) { return sameOwnedTexts(a.data(), b.data(), a.size()); }

int order(std::string const& a, std::string const& b) {
    return signOf(compareOwnedTexts(a.data(), b.data(), a.size()));
}

std::string makeText(std::size_t size) {
    std::string text(size, '\0');
    for (std::size_t i = 0; i < size; ++i) text[i] = static_cast<char>('a' + i % 26);
    return text;
}

} // namespace

INSTANTIATE_FOR_EACH_VECTORS(CompareTextWays);

TEST_P(CompareTextWays, find_a_difference_at_every_place) {
    for (std::size_t size = 1; size < 300; size += size < 70 ? 1 : 7) {
        std::string const a = makeText(size);
        ASSERT_TRUE(same(a, a)) << size;
        ASSERT_EQ(order(a, a), 0) << size;
        for (std::size_t place = 0; place < size; ++place) {
            std::string greater = a;
            greater[place] = '\xE9';
            ASSERT_FALSE(same(a, greater)) << size << ' ' << place;
            ASSERT_EQ(order(a, greater), -1) << size << ' ' << place;
            ASSERT_EQ(order(greater, a), 1) << size << ' ' << place;
        }
    }
}

TEST_P(CompareTextWays, look_no_further_than_a_common_zero) {
    for (std::size_t size = 1; size < 300; size += size < 70 ? 1 : 7) {
        for (std::size_t zero = 0; zero < size; ++zero) {
            std::string a = makeText(size);
            a[zero] = '\0';
            std::string other = a;
            for (std::size_t place = zero + 1; place < size; ++place) other[place] = '#';
            ASSERT_TRUE(same(a, other)) << size << ' ' << zero;
            ASSERT_EQ(order(a, other), 0) << size << ' ' << zero;
            other[zero] = '#';
            ASSERT_FALSE(same(a, other)) << size << ' ' << zero;
            ASSERT_EQ(order(a, other), -1) << size << ' ' << zero;
        }
    }
}

TEST_P(CompareTextWays, go_on_behind_the_length_for_the_order_only) {
    for (std::size_t size : {17U, 40U, 64U, 65U, 128U, 129U, 200U}) {
        std::string const a = makeText(size) + "1";
        std::string const b = makeText(size) + "2";
        EXPECT_TRUE(sameOwnedTexts(a.data(), b.data(), size)) << size;
        EXPECT_EQ(signOf(compareOwnedTexts(a.data(), b.data(), size)), -1) << size;
    }
}
