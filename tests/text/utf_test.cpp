// The conversions between UTF-8 and UTF-16 against a second, slow reading: mixtures of all kinds of characters, so that
// blocks and runs end at every place, in rooms that are too small, just large enough and larger.

#include "basis/text/utf.h"
#include "tests/support/random_steps.h"
#include "tests/text/reference_utf.h"

#include <gtest/gtest.h>

#include <algorithm>

using namespace ZOR_Basis;

namespace {

constexpr std::uint32_t FIRST_OF_KIND[] = {0x00, 0x80, 0x800, 0x10000};
constexpr std::uint32_t LAST_OF_KIND[] = {0x7F, 0x7FF, 0xFFFF, 0x10FFFF};

using Source = std::mt19937_64;

std::uint64_t upTo(Source& source, std::uint64_t last) { return source() % (last + 1); }

std::uint32_t randomCharacter(Source& source, std::size_t kind) {
    std::uint32_t const first = FIRST_OF_KIND[kind];
    auto const character = static_cast<std::uint32_t>(first + upTo(source, LAST_OF_KIND[kind] - first));
    return Utf::isSurrogate(character) ? character - 0x800 : character;
}

/// Runs of up to 20 characters of one kind, up to about 100 in all.
std::vector<std::uint32_t> randomText(Source& source) {
    std::vector<std::uint32_t> text;
    for (std::uint64_t size = upTo(source, 100); text.size() < size;) {
        std::size_t const kind = upTo(source, 3);
        for (std::uint64_t run = upTo(source, upTo(source, 1) == 0 ? 2 : 20); run > 0; --run)
            text.push_back(randomCharacter(source, kind));
    }
    return text;
}

/// An output whose room is followed by units that must stay as they are.
template <class Char>
struct Output {
    static constexpr std::size_t BEHIND = 32;
    static constexpr Char UNTOUCHED = static_cast<Char>(0x5A);
    explicit Output(std::uint64_t room) : units(room + BEHIND, UNTOUCHED) {}
    bool keptBehind() const {
        return std::all_of(units.end() - BEHIND, units.end(), [](Char unit) { return unit == UNTOUCHED; });
    }
    std::basic_string<Char> text(std::uint64_t size) const { return {units.data(), size}; }
    std::vector<Char> units;
};

std::uint64_t someRoom(Source& source, std::uint64_t needed) {
    std::uint64_t const around = upTo(source, 2 * 20);
    return needed + around > 20 ? needed + around - 20 : 0;
}

struct Way {
    char const* name;
    decltype(&Utf::toUtf16) toUtf16;
    decltype(&Utf::toUtf8) toUtf8;
};
void PrintTo(Way const& way, std::ostream* out) { *out << way.name; }

struct Conversion : testing::TestWithParam<Way> {
    Source source = randomSource();

    void narrowToWide(std::string const& narrow, std::uint64_t room) const {
        auto const characters = reference::characters(narrow);
        Output<WChar> output(room);
        std::uint64_t const size = GetParam().toUtf16(narrow.data(), narrow.size(), output.units.data(), room);
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
    void wideToNarrow(reference::WideText const& wide, std::uint64_t room) const {
        std::string const narrow = reference::utf8(reference::characters(wide));
        EXPECT_EQ(Utf::utf8Length(wide.data(), wide.size()), narrow.size());
        Output<char> output(room);
        auto const [size, hasZero] = GetParam().toUtf8(wide.data(), wide.size(), output.units.data(), room);
        EXPECT_TRUE(output.keptBehind());
        if (room < narrow.size()) {
            EXPECT_EQ(size, Utf::NO_ROOM);
        } else {
            ASSERT_EQ(size, narrow.size());
            EXPECT_EQ(output.text(size), narrow);
            EXPECT_EQ(hasZero, narrow.find('\0') != std::string::npos);
        }
    }
};

INSTANTIATE_TEST_SUITE_P(Ways, Conversion,
                         testing::Values(Way{"as_the_processor_can", Utf::toUtf16, Utf::toUtf8},
                                         Way{"without_shuffle", Utf::toUtf16WithoutShuffle, Utf::toUtf8WithoutShuffle}),
                         [](auto const& way) { return way.param.name; });

TEST_P(Conversion, Mixtures_of_all_kinds_both_ways) {
    for (std::uint64_t step = randomSteps(50'000); step > 0 && !HasFailure(); --step) {
        auto const text = randomText(source);
        std::string const narrow = reference::utf8(text);
        reference::WideText const wide = reference::utf16(text);
        narrowToWide(narrow, someRoom(source, wide.size()));
        wideToNarrow(wide, someRoom(source, narrow.size()));
    }
}

TEST_P(Conversion, A_damaged_byte_anywhere) {
    for (std::uint64_t step = randomSteps(50'000); step > 0 && !HasFailure(); --step) {
        std::string narrow = reference::utf8(randomText(source)) + "x";
        narrow[upTo(source, narrow.size() - 1)] = static_cast<char>(source());
        narrowToWide(narrow, narrow.size());
        narrowToWide(narrow, someRoom(source, Utf::utf16Length(narrow.data(), narrow.size())));
        narrow.pop_back();
        narrowToWide(narrow, narrow.size());
    }
}

TEST_P(Conversion, Surrogates_without_their_others) {
    for (std::uint64_t step = randomSteps(50'000); step > 0 && !HasFailure(); --step) {
        reference::WideText wide = reference::utf16(randomText(source)) + static_cast<WChar>('x');
        for (std::uint64_t count = upTo(source, 4); count > 0; --count)
            wide[upTo(source, wide.size() - 1)] = static_cast<WChar>(0xD800 + upTo(source, 0x7FF));
        wideToNarrow(wide, someRoom(source, 3 * wide.size()));
        wideToNarrow(wide, 3 * wide.size());
    }
}

TEST_P(Conversion, One_character_anywhere_among_others) {
    for (auto const& [others, one] : {std::pair{0x41u, 0u},
                                      {0x41u, 0xE9u},
                                      {0x41u, 0x20ACu},
                                      {0x41u, 0x1F600u},
                                      {0xE9u, 0x41u},
                                      {0x20ACu, 0x41u},
                                      {0x20ACu, 0xE9u},
                                      {0x20ACu, 0x1F600u},
                                      {0x1F600u, 0x20ACu},
                                      {0x1F600u, 0u}}) {
        for (std::size_t size = 1; size <= 80 && !HasFailure(); ++size) {
            for (std::size_t place = 0; place < size; ++place) {
                std::vector<std::uint32_t> text(size, others);
                text[place] = one;
                std::string const narrow = reference::utf8(text);
                reference::WideText const wide = reference::utf16(text);
                for (std::uint64_t missing : {0u, 1u}) {
                    narrowToWide(narrow, wide.size() - missing);
                    wideToNarrow(wide, narrow.size() - missing);
                }
                narrowToWide(narrow, wide.size() + 40);
                wideToNarrow(wide, narrow.size() + 40);
            }
        }
    }
}

TEST_P(Conversion, Lengths_beyond_what_one_round_of_sums_holds) {
    for (std::uint32_t character : {0x41u, 0xE9u, 0x20ACu, 0x1F600u}) {
        std::vector<std::uint32_t> const text(10'001, character);
        std::string const narrow = reference::utf8(text);
        reference::WideText const wide = reference::utf16(text);
        narrowToWide(narrow, wide.size());
        wideToNarrow(wide, narrow.size());
    }
}

} // namespace
