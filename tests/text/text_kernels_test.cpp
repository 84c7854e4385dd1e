// Copying and comparing narrow text at every length, at every place of a difference or a zero, and across pages: the
// short cuts have seams at 4, 8, 16, 32, 64, 128 and 256 bytes and where a page ends.

#include "tests/text/string_kinds.h"
#include "zor_basis/text.h"

#include <gtest/gtest.h>

#include <cstring>
#include <memory>
#include <string>

using namespace ZOR_Basis;

namespace {

constexpr std::size_t PageSize = 4096;

/// Room whose byte 0 begins a page. No byte is zero but the terminators of its texts.
class Pages {
public:
    Pages() { std::memset(room_.get(), '~', 4 * PageSize); }
    char* at(std::size_t place) { return base() + place; }
    /// A terminated text of `size` different letters that ends `before` bytes before the second page.
    char* text(std::size_t size, std::size_t before) {
        char* begin = base() + PageSize - before;
        for (std::size_t i = 0; i < size; ++i) begin[i] = static_cast<char>('a' + i % 26);
        begin[size] = '\0';
        return begin;
    }

private:
    char* base() {
        auto const address = reinterpret_cast<std::uintptr_t>(room_.get());
        return room_.get() + (PageSize - address % PageSize) % PageSize;
    }
    std::unique_ptr<char[]> room_ = std::make_unique<char[]>(4 * PageSize);
};

std::string stopAndPad(char const* text, std::size_t n) {
    std::string result(text, std::min<std::size_t>(n, std::strlen(text)));
    result.resize(n);
    return result;
}

int signOf(int order) { return (order > 0) - (order < 0); }

/// The order of two terminated texts, byte by byte.
int naiveOrder(char const* a, char const* b) {
    for (;; ++a, ++b) {
        int const left = static_cast<unsigned char>(*a);
        int const right = static_cast<unsigned char>(*b);
        if (left != right) return left < right ? -1 : 1;
        if (left == 0) return 0;
    }
}

/// Compares two strings of one kind in every way, beside plain loops.
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

TEST(TextKernels, copies_every_length_with_a_zero_at_every_place) {
    Pages pages;
    for (std::size_t size = 1; size <= 420; size += size < 70 ? 1 : 13) {
        for (std::size_t zero = 1; zero <= size; zero += size < 70 ? 1 : 7) {
            char* source = pages.text(size, PageSize - 64);
            source[zero] = '\0';
            std::string const expected = stopAndPad(source, size);
            ASSERT_EQ(contentOf(BufStr<255>(source, size)), expected) << size << ' ' << zero;
            ASSERT_EQ(contentOf(BufStr<255>(std::string(source, size))), expected) << size << ' ' << zero;
            BufStr<255> owner;
            owner.extendBuf(size);
            std::memcpy(owner.getBuf(), source, size);
            owner.getBuf()[zero] = 'x';
            owner.resize(size);
            if (zero < size) owner[zero] = '\0';
            ASSERT_EQ(contentOf(BufStr<15>(owner)), expected) << size << ' ' << zero;
            BufStr<255> const copy(owner);
            ASSERT_EQ(contentOf(copy), expected) << size << ' ' << zero;
        }
    }
}

TEST(TextKernels, copies_across_a_page) {
    Pages pages;
    for (std::size_t size : {3U, 7U, 15U, 16U, 31U, 64U, 65U, 130U, 254U, 300U, 700U}) {
        for (std::size_t before = 0; before <= size + 1; ++before) {
            char const* source = pages.text(size, before);
            ASSERT_EQ(contentOf(BufStr<255>(source, size)), std::string(source, size)) << size << ' ' << before;
            ASSERT_EQ(contentOf(BufStr<255>(source, size + 40)), stopAndPad(source, size + 40))
                << size << ' ' << before;
        }
    }
}

TEST(TextKernels, write_nothing_behind_the_text_wherever_the_source_lies) {
    struct Guarded {
        alignas(BufStr<255>) char string[sizeof(BufStr<255>)];
        char behind[3 * PageSize];
    };
    auto const guarded = std::make_unique<Guarded>();
    std::string const untouched(sizeof guarded->behind, '#');
    Pages pages;
    for (std::size_t size : {40U, 65U, 100U, 128U, 129U, 200U, 254U}) {
        for (std::size_t before = 0; before <= size + 1; ++before) {
            std::memcpy(guarded->behind, untouched.data(), untouched.size());
            auto* made = new (guarded->string) BufStr<255>(pages.text(size, before), size);
            ASSERT_EQ(std::string_view(guarded->behind, untouched.size()), untouched) << size << ' ' << before;
            made->~BufStr();
        }
    }
}

TEST(TextKernels, copies_within_one_text_whatever_overlaps) {
    for (std::size_t size : {20U, 60U, 120U, 254U, 600U, 1500U}) {
        for (std::size_t from = 1; from < size; from += 1 + from / 4) {
            BufStr<255> s;
            for (std::size_t i = 0; i < size; ++i) s += static_cast<char>('a' + i % 23);
            std::string const before = contentOf(s);
            s.copy(s.c_str() + from, size - from);
            ASSERT_EQ(contentOf(s), before.substr(from)) << size << ' ' << from;
        }
    }
}

TEST(TextKernels, copy_to_either_side_of_an_overlapping_source) {
    constexpr std::size_t Middle = 2000;
    for (std::size_t size : {3U, 7U, 15U, 20U, 40U, 60U, 100U, 200U, 256U, 257U, 600U, 1500U}) {
        for (std::size_t zero : {size / 2, size}) {
            for (std::size_t distance = 1; distance < size; distance += 1 + distance / 3) {
                for (bool down : {false, true}) {
                    std::string text(3 * Middle, '~');
                    char* source = text.data() + Middle;
                    for (std::size_t i = 0; i < size; ++i) source[i] = static_cast<char>('a' + i % 23);
                    source[zero] = '\0';
                    std::string const expected = stopAndPad(source, size);
                    char* target = down ? source - distance : source + distance;
                    detail::copyText(target, source, size);
                    ASSERT_EQ(std::string(target, size), expected) << size << ' ' << zero << ' ' << distance << down;
                }
            }
        }
    }
}

TEST(TextKernels, compare_every_length_with_a_difference_at_every_place) {
    Pages left;
    Pages right;
    for (std::size_t size = 0; size <= 300; size += size < 70 ? 1 : 13) {
        char* a = left.text(size, PageSize - 64);
        for (std::size_t place = 0; place <= size; place += size < 70 ? 1 : 5) {
            for (char other : {'A', 'z', '\xE9', '\0'}) {
                char* b = right.text(size, PageSize - 128 - 3);
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

TEST(TextKernels, compare_where_runs_of_64_bytes_meet) {
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

TEST(TextKernels, compare_what_lies_behind_a_common_zero_as_equal) {
    expectSameBehindCommonZero<15>();
    expectSameBehindCommonZero<255>();
}

TEST(TextKernels, compare_across_pages) {
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
