#include "tests/support/vectors.h"
#include "tests/text/random_utf.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct Utf16Length : EachVectors {};

std::uint64_t unitsOf(std::string const& text) { return Utf::utf16Length(text.data(), text.size()); }

std::string repeated(std::uint32_t character, std::size_t count) {
    return reference::utf8(std::vector<std::uint32_t>(count, character));
}

} // namespace

INSTANTIATE_FOR_EACH_VECTORS(Utf16Length);

TEST_P(Utf16Length, counts_each_kind_of_character) {
    EXPECT_EQ(unitsOf(""), 0u);
    EXPECT_EQ(unitsOf(std::string(1, '\0')), 1u);
    EXPECT_EQ(unitsOf("a\x7F"), 2u);
    EXPECT_EQ(unitsOf("\xC2\x80\xDF\xBF"), 2u);
    EXPECT_EQ(unitsOf("\xE0\xA0\x80\xEF\xBF\xBF"), 2u);
    EXPECT_EQ(unitsOf("\xF0\x90\x80\x80\xF4\x8F\xBF\xBF"), 4u);
}

TEST_P(Utf16Length, sums_long_texts_of_every_kind) {
    for (std::uint32_t const character : {0x41u, 0xE9u, 0x20ACu, 0x1F600u}) {
        std::uint64_t const units = character < 0x10000 ? 1 : 2;
        for (std::size_t const count : {1000u, 1019u, 1020u, 1021u, 1360u, 2040u, 4079u, 4080u, 4081u, 10'001u})
            EXPECT_EQ(unitsOf(repeated(character, count)), units * count) << character << ' ' << count;
    }
}

TEST_P(Utf16Length, finds_a_fault_behind_any_front) {
    for (std::uint32_t const character : {0x41u, 0xE9u, 0x20ACu, 0x1F600u}) {
        for (std::size_t count = 0; count < 140; ++count) {
            std::string const front = repeated(character, count);
            EXPECT_EQ(unitsOf(front + "\x80"), Utf::INVALID) << character << ' ' << count;
            EXPECT_EQ(unitsOf(front + "\xE2\x82"), Utf::INVALID) << character << ' ' << count;
            EXPECT_EQ(unitsOf(front + "\xF0" + std::string(40, 'a')), Utf::INVALID) << character << ' ' << count;
        }
    }
}
