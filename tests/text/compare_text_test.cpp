// Compares narrow texts of every length, with a difference or a zero at every place, and across pages: the code paths
// change at 4, 8, 16, 32, 64, 128 and 256 bytes and at the end of a page.

#include "tests/text/naive_order.h"
#include "tests/text/pages.h"
#include "tests/text/string_kinds.h"
#include "zor_basis/text.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

using namespace ZOR_Basis;

namespace {

/// Compares two strings of one kind in every way and checks the results against plain loops.
template <std::uint64_t N>
void expectLikeRuntime(BufStr<N> const& a, BufStr<N> const& b) {
    int const order = naiveOrder(a, b);
    EXPECT_EQ(a.compare(b), order);
    EXPECT_EQ(b.compare(a), -order);
    EXPECT_EQ(a < b, order < 0);
    EXPECT_EQ(b >= a, order <= 0);
    bool const same = b.size() == 0 ? order == 0 : a.size() == b.size() && std::strncmp(a, b, a.size()) == 0;
    EXPECT_EQ(a == b, same);
}

template <std::uint64_t N>
void expectSameBehindCommonZero() {
    for (std::size_t size : {1U, 2U, 3U, 5U, 7U, 8U, 9U, 14U, 16U, 17U, 30U, 33U, 64U, 65U, 100U, 129U, 200U, 254U}) {
        for (std::size_t zero = 0; zero < size; ++zero) {
            BufStr<N> a(std::string(size, 'q'));
            BufStr<N> b(a);
            a[zero] = b[zero] = '\0';
            for (std::size_t i = zero + 1; i < size; ++i) b[i] = static_cast<char>('A' + i % 26);
            ASSERT_TRUE(a == b) << size << ' ' << zero;
            ASSERT_EQ(a.compare(b), 0) << size << ' ' << zero;
            ASSERT_TRUE(static_cast<Str const&>(a) == static_cast<Str const&>(b)) << size << ' ' << zero;
            ASSERT_EQ(a.compare(static_cast<Str const&>(b)), 0) << size << ' ' << zero;
            if (zero == 0) continue;
            b[zero - 1] = 'r';
            ASSERT_FALSE(a == b) << size << ' ' << zero;
            ASSERT_EQ(a.compare(b), -1) << size << ' ' << zero;
        }
    }
}

} // namespace

TEST(CompareText, compares_every_length_with_a_difference_at_every_place) {
    Pages left;
    Pages right;
    for (std::size_t size = 0; size <= 300; size += size < 70 ? 1 : 13) {
        char* a = left.text(size, PAGE_SIZE - 64);
        for (std::size_t place = 0; place <= size; place += size < 70 ? 1 : 5) {
            for (char other : {'A', 'z', '\xE9', '\0'}) {
                char* b = right.text(size, PAGE_SIZE - 128 - 3);
                b[place] = other;
                b[size + 1] = '\0';
                int const order = naiveOrder(a, b);
                bool const same = std::strncmp(a, b, size) == 0;
                std::uint64_t const bSize = std::max(size, place == size && other != '\0' ? size + 1 : size);
                ASSERT_EQ(Str(a, size).compare(Str(b, bSize)), order) << size << ' ' << place;
                ASSERT_EQ(Str(b, bSize).compare(Str(a, size)), -order) << size << ' ' << place;
                ASSERT_EQ(Str(a, size / 2).compare(Str(b, 3)), order) << "sizes only guide the reading";
                ASSERT_EQ(Str(a, size / 2).compare(Str(b, size)), order) << size << ' ' << place;
                ASSERT_EQ(Str(a, size + 500).compare(Str(b, size + 900)), order);
                ASSERT_EQ(Str(a).compare(b), order);
                ASSERT_EQ(signOf(Str(a).compare(b, size + 1)), order);
                ASSERT_TRUE(size == 0 || (Str(a, size) == Str(b, size)) == same) << size << ' ' << place;
                ASSERT_EQ(Str(a, size) == Str(b, 0), order == 0);
                expectLikeRuntime(BufStr<15>(a, size), BufStr<15>(b, bSize));
                expectLikeRuntime(BufStr<255>(a, size), BufStr<255>(b, bSize));
                ASSERT_FALSE(testing::Test::HasFailure()) << size << ' ' << place;
            }
        }
    }
}

TEST(CompareText, compares_where_runs_of_64_bytes_meet) {
    for (std::size_t size : {127U, 128U, 129U, 191U, 192U, 193U, 256U, 257U, 320U, 321U, 400U, 449U}) {
        BufStr<255> const a(std::string(size, 'q'));
        ASSERT_TRUE(a == BufStr<255>(a)) << size;
        for (std::size_t place = 0; place < size; ++place) {
            BufStr<255> b(a);
            b[place] = 'r';
            ASSERT_FALSE(a == b) << size << ' ' << place;
            ASSERT_EQ(a.compare(b), -1) << size << ' ' << place;
            b[place] = '\0';
            ASSERT_FALSE(a == b) << size << ' ' << place;
            ASSERT_EQ(a.compare(b), 1) << size << ' ' << place;
        }
    }
}

TEST(CompareText, compares_what_lies_behind_a_common_zero_as_equal) {
    expectSameBehindCommonZero<15>();
    expectSameBehindCommonZero<255>();
}

TEST(CompareText, compares_across_pages) {
    Pages left;
    Pages right;
    for (std::size_t size : {2U, 5U, 13U, 16U, 31U, 60U, 65U, 130U, 300U}) {
        for (std::size_t before = 0; before <= size + 1; ++before) {
            char* a = left.text(size, before);
            char* b = right.text(size, (before * 7) % (size + 2));
            ASSERT_TRUE(Str(a, size) == Str(b, size)) << size << ' ' << before;
            ASSERT_TRUE(Str(a, size + 70) == Str(b, size + 70)) << size << ' ' << before;
            ASSERT_EQ(Str(a, size).compare(Str(b, size)), 0);
            b[size - 1] = '~';
            ASSERT_FALSE(Str(a, size) == Str(b, size)) << size << ' ' << before;
            ASSERT_EQ(Str(a, size).compare(Str(b, size)), -1) << size << ' ' << before;
        }
    }
}
