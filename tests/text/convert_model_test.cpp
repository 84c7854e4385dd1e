// Compares conversions of random texts with those of a second, plain implementation.

#include "tests/text/convert_check.h"

#include "tests/support/random_steps.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using namespace ZOR_Basis;
using reference::WideText;

namespace {

std::uint32_t randomCharacter(std::mt19937_64& random) {
    static constexpr std::uint32_t LIMITS[] = {0x80, 0x80, 0x800, 0x10000, 0x110000};
    for (;;) {
        std::uint32_t const c = static_cast<std::uint32_t>(random() % LIMITS[random() % 5]);
        if (c != 0 && (c < 0xD800 || c > 0xDFFF)) return c;
    }
}

/// Runs of one kind of character, because the conversions have a path for each kind.
std::vector<std::uint32_t> randomCharacters(std::mt19937_64& random) {
    std::vector<std::uint32_t> found;
    for (std::uint64_t run = random() % 5; run > 0; --run) {
        std::uint32_t const c = randomCharacter(random);
        found.insert(found.end(), random() % (random() % 4 == 0 ? 120 : 20), c);
        found.push_back(randomCharacter(random));
    }
    return found;
}

} // namespace

TEST(ConvertModel, agrees_with_the_second_reading_on_valid_text) {
    std::mt19937_64 random = randomSource();
    for (std::uint64_t step = randomSteps(20'000); step > 0; --step) {
        std::vector<std::uint32_t> const characters = randomCharacters(random);
        std::string const narrow = reference::utf8(characters);
        WideText const wide = reference::utf16(characters);
        WBStr toWide;
        ASSERT_TRUE(Convert::Utf8ToWide(narrow.c_str(), toWide, narrow.size()));
        ASSERT_EQ(unitsOf(toWide), wide);
        BufStr<255> toNarrow;
        ASSERT_TRUE(Convert::WideToUtf8(wide.c_str(), toNarrow, wide.size()));
        ASSERT_EQ(bytesOf(toNarrow), narrow);
    }
}

TEST(ConvertModel, agrees_with_the_second_reading_on_damaged_text) {
    std::mt19937_64 random = randomSource();
    for (std::uint64_t step = randomSteps(50'000); step > 0; --step) {
        std::string text = reference::utf8(randomCharacters(random));
        if (text.empty()) continue;
        for (std::uint64_t damage = random() % 3; damage > 0; --damage)
            text[random() % text.size()] = static_cast<char>(1 + random() % 255);
        text.resize(1 + random() % text.size());
        auto const expected = reference::characters(text);
        WBStr wide;
        ASSERT_EQ(Convert::Utf8ToWide(text.c_str(), wide, text.size()), expected.has_value());
        ASSERT_EQ(unitsOf(wide), expected ? reference::utf16(*expected) : WideText());
    }
}

TEST(ConvertModel, agrees_with_the_second_reading_on_any_units) {
    std::mt19937_64 random = randomSource();
    for (std::uint64_t step = randomSteps(50'000); step > 0; --step) {
        WideText text;
        for (std::uint64_t n = random() % 60; n > 0; --n) {
            std::uint64_t const kind = random() % 4;
            text.push_back(static_cast<WChar>(kind == 0   ? 1 + random() % 0x7F
                                              : kind == 1 ? 0xD800 + random() % 0x800
                                                          : 1 + random() % 0xFFFF));
        }
        BufStr<255> narrow;
        ASSERT_TRUE(Convert::WideToUtf8(text.c_str(), narrow, text.size()));
        ASSERT_EQ(bytesOf(narrow), reference::utf8(reference::characters(text)));
    }
}
