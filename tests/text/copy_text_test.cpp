// Copies narrow texts of every length, with a zero at every place, and across pages: the code paths change at 4, 8, 16,
// 32, 64, 128 and 256 bytes and at the end of a page.

#include "tests/text/pages.h"
#include "tests/text/string_kinds.h"
#include "zor_basis/text.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <string>

using namespace ZOR_Basis;

namespace {

std::string stopAndPad(char const* text, std::size_t n) {
    std::string result(text, std::min<std::size_t>(n, std::strlen(text)));
    result.resize(n);
    return result;
}

} // namespace

TEST(CopyText, copies_every_length_with_a_zero_at_every_place) {
    Pages pages;
    for (std::size_t size = 1; size <= 420; size += size < 70 ? 1 : 13) {
        for (std::size_t zero = 1; zero <= size; zero += size < 70 ? 1 : 7) {
            char* source = pages.text(size, PAGE_SIZE - 64);
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

TEST(CopyText, copies_across_a_page) {
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

TEST(CopyText, writes_nothing_behind_the_text_wherever_the_source_lies) {
    struct Guarded {
        alignas(BufStr<255>) char string[sizeof(BufStr<255>)];
        char behind[3 * PAGE_SIZE];
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

TEST(CopyText, copies_within_one_text_whatever_overlaps) {
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

TEST(CopyText, copies_to_either_side_of_an_overlapping_source) {
    constexpr std::size_t MIDDLE = 2000;
    for (std::size_t size : {3U, 7U, 15U, 20U, 40U, 60U, 100U, 200U, 256U, 257U, 600U, 1500U}) {
        for (std::size_t zero : {size / 2, size}) {
            for (std::size_t distance = 1; distance < size; distance += 1 + distance / 3) {
                for (bool down : {false, true}) {
                    std::string text(3 * MIDDLE, '~');
                    char* source = text.data() + MIDDLE;
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
