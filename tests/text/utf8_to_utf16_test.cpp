// Compares the conversion from UTF-8 to UTF-16 with a second, slow one. The texts mix all kinds of characters, so that
// blocks and runs end at every place; the outputs are too small, just large enough, and larger.

#include "tests/text/random_utf.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

using Utf8ToUtf16Way = mixture::Way<decltype(Utf::toUtf16)>;

struct Utf8ToUtf16 : testing::TestWithParam<Utf8ToUtf16Way> {
    mixture::Source source = randomSource();

    void check(std::string const& narrow, std::uint64_t room) const {
        auto const characters = reference::characters(narrow);
        mixture::Output<WChar> output(room);
        std::uint64_t const size = GetParam().convert(narrow.data(), narrow.size(), output.units.data(), room);
        EXPECT_TRUE(output.keptBehind());
        if (size == Utf::NO_ROOM) {
            EXPECT_GT(Utf::utf16Length(narrow.data(), narrow.size()), room);
        } else if (!characters) {
            EXPECT_EQ(size, Utf::INVALID);
        } else {
            reference::WideText const wide = reference::utf16(*characters);
            EXPECT_EQ(Utf::utf16Length(narrow.data(), narrow.size()), wide.size());
            ASSERT_EQ(size, wide.size());
            EXPECT_EQ(output.text(size), wide);
        }
    }

    void checkMixture(std::vector<std::uint32_t> const& text) {
        std::string const narrow = reference::utf8(text);
        reference::WideText const wide = reference::utf16(text);
        check(narrow, mixture::someRoom(source, wide.size()));
    }
    void checkRooms(std::vector<std::uint32_t> const& text) const {
        std::string const narrow = reference::utf8(text);
        reference::WideText const wide = reference::utf16(text);
        for (std::uint64_t room : {wide.size() - 1, wide.size(), wide.size() + 40}) check(narrow, room);
    }
};

} // namespace

INSTANTIATE_TEST_SUITE_P(Ways, Utf8ToUtf16,
                         testing::Values(Utf8ToUtf16Way{"as_the_processor_can", Utf::toUtf16},
                                         Utf8ToUtf16Way{"without_shuffle", Utf::toUtf16WithoutShuffle}),
                         [](auto const& way) { return way.param.name; });

TEST_P(Utf8ToUtf16, converts_mixtures_of_all_kinds_of_characters) {
    for (std::uint64_t step = randomSteps(50'000); step > 0 && !HasFailure(); --step)
        checkMixture(mixture::randomText(source));
}

TEST_P(Utf8ToUtf16, converts_text_with_a_damaged_byte_anywhere) {
    for (std::uint64_t step = randomSteps(50'000); step > 0 && !HasFailure(); --step) {
        std::string narrow = reference::utf8(mixture::randomText(source)) + "x";
        narrow[mixture::upTo(source, narrow.size() - 1)] = static_cast<char>(source());
        check(narrow, narrow.size());
        check(narrow, mixture::someRoom(source, Utf::utf16Length(narrow.data(), narrow.size())));
        narrow.pop_back();
        check(narrow, narrow.size());
    }
}

TEST_P(Utf8ToUtf16, converts_one_character_anywhere_among_others) {
    mixture::forOneAmongOthers([this](std::vector<std::uint32_t> const& text) { checkRooms(text); });
}

TEST_P(Utf8ToUtf16, converts_lengths_beyond_what_one_round_of_sums_holds) {
    mixture::forLongTexts([this](std::vector<std::uint32_t> const& text) { checkRooms(text); });
}
