// Compares the conversion from UTF-16 to UTF-8 with a second, slow one. The texts mix all kinds of characters, so that
// blocks and runs end at every place; the outputs are too small, just large enough, and larger.

#include "tests/text/random_utf.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

using Utf16ToUtf8Way = mixture::Way<decltype(Utf::toUtf8)>;

struct Utf16ToUtf8 : testing::TestWithParam<Utf16ToUtf8Way> {
    mixture::Source source = randomSource();

    void check(reference::WideText const& wide, std::uint64_t room) const {
        std::string const narrow = reference::utf8(reference::characters(wide));
        EXPECT_EQ(Utf::utf8Length(wide.data(), wide.size()), narrow.size());
        mixture::Output<char> output(room);
        auto const [size, hasZero] = GetParam().convert(wide.data(), wide.size(), output.units.data(), room);
        EXPECT_TRUE(output.keptBehind());
        if (room < narrow.size()) {
            EXPECT_EQ(size, Utf::NO_ROOM);
        } else {
            ASSERT_EQ(size, narrow.size());
            EXPECT_EQ(output.text(size), narrow);
            EXPECT_EQ(hasZero, narrow.find('\0') != std::string::npos);
        }
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

INSTANTIATE_TEST_SUITE_P(Ways, Utf16ToUtf8,
                         testing::Values(Utf16ToUtf8Way{"as_the_processor_can", Utf::toUtf8},
                                         Utf16ToUtf8Way{"without_shuffle", Utf::toUtf8WithoutShuffle}),
                         [](auto const& way) { return way.param.name; });

TEST_P(Utf16ToUtf8, converts_mixtures_of_all_kinds_of_characters) {
    for (std::uint64_t step = randomSteps(50'000); step > 0 && !HasFailure(); --step)
        checkMixture(mixture::randomText(source));
}

TEST_P(Utf16ToUtf8, converts_surrogates_without_their_others) {
    for (std::uint64_t step = randomSteps(50'000); step > 0 && !HasFailure(); --step) {
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
