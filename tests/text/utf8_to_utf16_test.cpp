// Compares the conversion from UTF-8 to UTF-16 with a second, slow one. The texts mix all kinds of characters, so that
// blocks and runs end at every place; the outputs are too small, just large enough, and larger.

#include "tests/support/vectors.h"
#include "tests/text/random_utf.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct Utf8ToUtf16 : EachVectors {
    mixture::Source source = randomSource();

    void check(std::string const& narrow, std::uint64_t room) const {
        auto const characters = reference::characters(narrow);
        mixture::Output<WChar> output(room);
        std::uint64_t const length = Utf::utf16Length(narrow.data(), narrow.size());
        std::uint64_t const size = Utf::toUtf16(narrow.data(), narrow.size(), output.units.data(), room);
        EXPECT_TRUE(output.keptBehind());
        if (!characters) {
            EXPECT_EQ(length, Utf::INVALID);
            EXPECT_TRUE(size == Utf::INVALID || size == Utf::NO_ROOM);
            return;
        }
        reference::WideText const wide = reference::utf16(*characters);
        EXPECT_EQ(length, wide.size());
        ASSERT_EQ(size, room >= wide.size() ? wide.size() : Utf::NO_ROOM);
        if (size == Utf::NO_ROOM) return;
        EXPECT_EQ(output.text(size), wide);
        mixture::Output<WChar> unchecked(room);
        Utf::validToUtf16(narrow.data(), narrow.size(), unchecked.units.data(), room);
        EXPECT_TRUE(unchecked.keptBehind());
        EXPECT_EQ(unchecked.text(size), wide);
    }

    /// In so much room, a fault must be found.
    void checkFault(std::string const& narrow) const {
        std::vector<WChar> room(narrow.size());
        ASSERT_FALSE(reference::characters(narrow)) << testing::PrintToString(narrow);
        EXPECT_EQ(Utf::toUtf16(narrow.data(), narrow.size(), room.data(), room.size()), Utf::INVALID)
            << testing::PrintToString(narrow);
        EXPECT_EQ(Utf::utf16Length(narrow.data(), narrow.size()), Utf::INVALID) << testing::PrintToString(narrow);
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

INSTANTIATE_FOR_EACH_VECTORS(Utf8ToUtf16);

TEST_P(Utf8ToUtf16, converts_mixtures_of_all_kinds_of_characters) {
    for (std::uint64_t step = randomSteps(20'000); step > 0 && !HasFailure(); --step)
        checkMixture(mixture::randomText(source));
}

TEST_P(Utf8ToUtf16, converts_text_with_a_damaged_byte_anywhere) {
    for (std::uint64_t step = randomSteps(20'000); step > 0 && !HasFailure(); --step) {
        std::string narrow = reference::utf8(mixture::randomText(source)) + "x";
        narrow[mixture::upTo(source, narrow.size() - 1)] = static_cast<char>(source());
        check(narrow, narrow.size());
        check(narrow, mixture::someRoom(source, narrow.size() / 2));
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

TEST_P(Utf8ToUtf16, refuses_every_invalid_sequence_at_every_place) {
    constexpr char const* FAULTS[] = {"\x80",
                                      "\xBF",
                                      "\xC0\x80",
                                      "\xC1\xBF",
                                      "\xC2",
                                      "\xDF",
                                      "\xC2\x41",
                                      "\xC2\xC2",
                                      "\xE0\x9F\xBF",
                                      "\xE0\x80\x80",
                                      "\xE1\x80",
                                      "\xE1\x80\x41",
                                      "\xE1\x41\x80",
                                      "\xED\xA0\x80",
                                      "\xED\xBF\xBF",
                                      "\xEF\xBF",
                                      "\xF0\x8F\xBF\xBF",
                                      "\xF0\x80\x80\x80",
                                      "\xF1\x80\x80",
                                      "\xF1\x80\x80\x41",
                                      "\xF1\x80\x41\x80",
                                      "\xF4\x90\x80\x80",
                                      "\xF4\xBF\xBF\xBF",
                                      "\xF5\x80\x80\x80",
                                      "\xF8\x88\x80\x80",
                                      "\xFE",
                                      "\xFF",
                                      "\xC3\xA9\x80",
                                      "\xE2\x82\xAC\x80",
                                      "\xF0\x9F\x98\x80\x80"};
    for (std::string const fault : FAULTS) {
        for (std::string const other : {"a", "\xC3\xA9", "\xE2\x82\xAC", "\xF0\x9F\x98\x80"}) {
            for (std::size_t before = 0; before < 40; ++before) {
                for (std::size_t behind : {0U, 1U, 2U, 5U, 17U, 33U}) {
                    std::string text;
                    for (std::size_t i = 0; i < before; ++i) text += other;
                    text += fault;
                    for (std::size_t i = 0; i < behind; ++i) text += other;
                    checkFault(text);
                }
            }
        }
    }
}

TEST_P(Utf8ToUtf16, knows_every_character_and_every_pair_of_bytes) {
    for (std::uint32_t character = 0; character <= 0x10FFFF; character += character < 0x3000 ? 1 : 61) {
        if (Utf::isSurrogate(character)) continue;
        std::string const narrow = "0123456789abc" + reference::utf8(std::vector<std::uint32_t>{character});
        check(narrow, narrow.size());
    }
    for (unsigned pair = 0; pair < 0x10000; ++pair) {
        std::string narrow = "0123456789abcde__ghijklmnopqrstuv";
        narrow[15] = static_cast<char>(pair >> 8);
        narrow[16] = static_cast<char>(pair);
        check(narrow, narrow.size());
    }
}
