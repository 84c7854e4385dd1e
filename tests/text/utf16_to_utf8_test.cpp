// Compares the conversion from UTF-16 to UTF-8 with a second, slow one. The texts mix all kinds of characters, so that
// blocks and runs end at every place; the outputs are too small, just large enough, and larger.

#include "tests/support/vectors.h"
#include "tests/text/random_utf.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

/// The most bytes of eight units: so much room may be left where the next characters do not fit.
constexpr std::uint64_t LONGEST_BLOCK = 8 * 3;

std::string narrowOf(reference::WideText const& wide) { return reference::utf8(reference::characters(wide)); }

struct Utf16ToUtf8 : EachVectors {
    mixture::Source source = randomSource();

    void check(reference::WideText const& wide, std::uint64_t room) const {
        std::string const narrow = narrowOf(wide);
        EXPECT_EQ(Utf::utf8Length(wide.data(), wide.size()), narrow.size());
        mixture::Output<char> output(room);
        Utf::Utf8Result const result = Utf::toUtf8(wide.data(), wide.size(), output.units.data(), room);
        EXPECT_TRUE(output.keptBehind());
        EXPECT_EQ(result.units == wide.size(), room >= narrow.size());
        std::string const front = result.units == wide.size() ? narrow : narrowOf(wide.substr(0, result.units));
        ASSERT_EQ(result.bytes, front.size());
        EXPECT_EQ(output.text(result.bytes), front);
        EXPECT_EQ(result.hasZero != 0, front.find('\0') != std::string::npos);
        if (result.units == wide.size()) return;
        EXPECT_GT(result.bytes + LONGEST_BLOCK, room);
        EXPECT_EQ(front + narrowOf(wide.substr(result.units)), narrow);
    }

    void checkMixture(std::vector<std::uint32_t> const& text) {
        std::string const narrow = reference::utf8(text);
        reference::WideText const wide = reference::utf16(text);
        check(wide, mixture::someRoom(source, narrow.size()));
    }
    void checkRooms(std::vector<std::uint32_t> const& text) const {
        std::string const narrow = reference::utf8(text);
        reference::WideText const wide = reference::utf16(text);
        for (std::uint64_t room : {narrow.size() - 1, narrow.size(), narrow.size() + 40}) check(wide, room);
    }
};

} // namespace

INSTANTIATE_FOR_EACH_VECTORS(Utf16ToUtf8);

TEST_P(Utf16ToUtf8, converts_mixtures_of_all_kinds_of_characters) {
    for (std::uint64_t step = randomSteps(20'000); step > 0 && !HasFailure(); --step)
        checkMixture(mixture::randomText(source));
}

TEST_P(Utf16ToUtf8, converts_surrogates_without_their_others) {
    for (std::uint64_t step = randomSteps(20'000); step > 0 && !HasFailure(); --step) {
        reference::WideText wide = reference::utf16(mixture::randomText(source)) + static_cast<WChar>('x');
        for (std::uint64_t count = mixture::upTo(source, 4); count > 0; --count)
            wide[mixture::upTo(source, wide.size() - 1)] = static_cast<WChar>(0xD800 + mixture::upTo(source, 0x7FF));
        check(wide, mixture::someRoom(source, 3 * wide.size()));
        check(wide, 3 * wide.size());
    }
}

TEST_P(Utf16ToUtf8, converts_one_character_anywhere_among_others) {
    mixture::forOneAmongOthers([this](std::vector<std::uint32_t> const& text) { checkRooms(text); });
}

TEST_P(Utf16ToUtf8, converts_lengths_beyond_what_one_round_of_sums_holds) {
    mixture::forLongTexts([this](std::vector<std::uint32_t> const& text) { checkRooms(text); });
}
