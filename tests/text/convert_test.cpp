#include <zor_basis/text/convert.h>

#include "tests/support/random_steps.h"
#include "tests/support/table.h"
#include "tests/text/reference_utf.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>

using namespace ZOR_Basis;
using reference::WideText;

namespace {

std::string bytesOf(BufStr<255> const& text) { return {text.c_str(), text.size()}; }
WideText unitsOf(WBStr const& text) { return {text.wstr(), text.size()}; }

Convert::Encoding encoding(std::uint32_t value) { return static_cast<Convert::Encoding>(value); }

/// A result that was there before, on the heap, so that a function that forgets to empty its output is seen.
template <class Text>
Text filled() {
    Text text;
    for (int i = 0; i < 300; ++i) text += 'x';
    return text;
}

} // namespace

TEST(Convert, breathes) {
    WBStr wide;
    EXPECT_TRUE(Convert::Utf8ToWide("\xC3\xA4pfel", wide));
    EXPECT_EQ(unitsOf(wide), ZB_W("\u00E4pfel"));
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToUtf8(wide, narrow));
    EXPECT_EQ(bytesOf(narrow), "\xC3\xA4pfel");
}

// ---- UTF-8 to wide -------------------------------------------------------------------------------------------------

TEST(ConvertUtf8ToWide, accepts_the_bounds_of_every_length) {
    struct Case {
        Row row;
        char const* text;
        WideText expected;
    };
    for (Case const& c : {
             Case{{}, "\x01", {0x01}},
             Case{{}, "\x7F", {0x7F}},
             Case{{}, "\xC2\x80", {0x80}},
             Case{{}, "\xDF\xBF", {0x7FF}},
             Case{{}, "\xE0\xA0\x80", {0x800}},
             Case{{}, "\xED\x9F\xBF", {0xD7FF}},
             Case{{}, "\xEE\x80\x80", {0xE000}},
             Case{{}, "\xEF\xBF\xBF", {0xFFFF}},
             Case{{}, "\xF0\x90\x80\x80", {0xD800, 0xDC00}},
             Case{{}, "\xF4\x8F\xBF\xBF", {0xDBFF, 0xDFFF}},
             Case{{},
                  "\xEF\xBB\xBF"
                  "a",
                  {0xFEFF, 'a'}},
         }) {
        SCOPED_TRACE(c.row);
        for (std::string const& around : {std::string(), std::string("ab"), std::string(40, 'z')}) {
            WBStr wide = filled<WBStr>();
            EXPECT_TRUE(Convert::Utf8ToWide(around + c.text + around, wide));
            WideText const side(around.begin(), around.end());
            EXPECT_EQ(unitsOf(wide), side + c.expected + side);
        }
    }
}

TEST(ConvertUtf8ToWide, refuses_every_kind_of_invalid_text_and_leaves_nothing) {
    struct Case {
        Row row;
        char const* text;
    };
    for (Case const& c : {
             Case{{}, "\x80"},         // a continuation alone
             Case{{}, "\xBF"},         //
             Case{{}, "\xC3"},         // cut after the first byte
             Case{{}, "\xE2\x82"},     // cut after the second
             Case{{}, "\xE2"},         //
             Case{{}, "\xF0\x9F\x98"}, // cut after the third
             Case{{}, "\xF0\x9F"},     //
             Case{{}, "\xF0"},         //
             Case{{},
                  "\xC3"
                  "a"}, // a letter where a continuation belongs
             Case{{},
                  "\xE2\x82"
                  "a"}, //
             Case{{},
                  "\xE2"
                  "a\x82"}, //
             Case{{},
                  "\xF0\x9F\x98"
                  "a"}, //
             Case{{},
                  "\xF0\x9F"
                  "a\x80"}, //
             Case{{},
                  "\xF0"
                  "a\x98\x80"},                    //
             Case{{}, "\xC3\xC3\xA4"},             // a start where a continuation belongs
             Case{{}, "\xC0\x80"},                 // overlong
             Case{{}, "\xC0\xAF"},                 //
             Case{{}, "\xC1\xBF"},                 //
             Case{{}, "\xE0\x80\x80"},             //
             Case{{}, "\xE0\x9F\xBF"},             //
             Case{{}, "\xF0\x80\x80\x80"},         //
             Case{{}, "\xF0\x8F\xBF\xBF"},         //
             Case{{}, "\xED\xA0\x80"},             // a surrogate
             Case{{}, "\xED\xBF\xBF"},             //
             Case{{}, "\xED\xA0\xBD\xED\xB8\x80"}, // a pair of them
             Case{{}, "\xF4\x90\x80\x80"},         // above U+10FFFF
             Case{{}, "\xF5\x80\x80\x80"},         //
             Case{{}, "\xF7\xBF\xBF\xBF"},         //
             Case{{}, "\xF8\x88\x80\x80\x80"},     // no such start
             Case{{}, "\xFC\x84\x80\x80\x80\x80"}, //
             Case{{}, "\xFE"},                     //
             Case{{}, "\xFF"},                     //
         }) {
        SCOPED_TRACE(c.row);
        for (std::string const& around : {std::string(), std::string("ab"), std::string(40, 'z'), std::string(400, 'q'),
                                          std::string("\xE2\x82\xAC\xE2\x82\xAC\xE2\x82\xAC\xE2\x82\xAC")}) {
            WBStr wide = filled<WBStr>();
            EXPECT_FALSE(Convert::Utf8ToWide(around + c.text, wide));
            EXPECT_EQ(wide.size(), 0u);
            EXPECT_EQ(wide.wstr()[0], 0);
            EXPECT_FALSE(Convert::Utf8ToWide(around + c.text + around, wide));
            EXPECT_EQ(wide.size(), 0u);
        }
    }
}

TEST(ConvertUtf8ToWide, never_reads_past_the_given_length) {
    // Cut right behind the first, second and third byte of four, with the rest of the character lying behind.
    char const text[] = "ab\xF0\x9F\x98\x80";
    WBStr wide;
    for (std::uint64_t length : {3u, 4u, 5u}) EXPECT_FALSE(Convert::Utf8ToWide(text, wide, length)) << length;
    EXPECT_TRUE(Convert::Utf8ToWide(text, wide, 2));
    EXPECT_EQ(unitsOf(wide), ZB_W("ab"));
    EXPECT_TRUE(Convert::Utf8ToWide(text, wide, 6));
    EXPECT_EQ(wide.size(), 4u);
}

TEST(ConvertUtf8ToWide, takes_a_zero_inside_a_given_length_as_text) {
    WBStr wide;
    EXPECT_TRUE(Convert::Utf8ToWide("a\0b", wide, 3));
    EXPECT_EQ(unitsOf(wide), WideText(ZB_W("a\0b"), 3));
    EXPECT_TRUE(Convert::Utf8ToWide("\0ab", wide, 3));
    EXPECT_EQ(unitsOf(wide), WideText(ZB_W("\0ab"), 3));
}

// ---- wide to UTF-8 -------------------------------------------------------------------------------------------------

TEST(ConvertWideToUtf8, replaces_unpaired_surrogates) {
    struct Case {
        Row row;
        WideText text;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, {0xD800}, "\xEF\xBF\xBD"},
             Case{{}, {0xDC00}, "\xEF\xBF\xBD"},
             Case{{},
                  {0xDBFF, 'a'},
                  "\xEF\xBF\xBD"
                  "a"},
             Case{{},
                  {'a', 0xDFFF, 'b'},
                  "a\xEF\xBF\xBD"
                  "b"},
             Case{{}, {0xDC00, 0xD800}, "\xEF\xBF\xBD\xEF\xBF\xBD"},
             Case{{}, {0xD800, 0xD800, 0xDC00}, "\xEF\xBF\xBD\xF0\x90\x80\x80"},
             Case{{}, {0xD83D, 0xDE00}, "\xF0\x9F\x98\x80"},
             Case{{}, {0xDBFF, 0xDFFF}, "\xF4\x8F\xBF\xBF"},
             Case{{}, {0x80, 0x7FF, 0x800, 0xFFFF}, "\xC2\x80\xDF\xBF\xE0\xA0\x80\xEF\xBF\xBF"},
         }) {
        SCOPED_TRACE(c.row);
        BufStr<255> narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::WideToUtf8(c.text.c_str(), narrow, c.text.size()));
        EXPECT_EQ(bytesOf(narrow), c.expected);
    }
}

TEST(ConvertWideToUtf8, never_pairs_with_a_unit_past_the_given_length) {
    WideText const text{'a', 0xD83D, 0xDE00};
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToUtf8(text.c_str(), narrow, 2));
    EXPECT_EQ(bytesOf(narrow), "a\xEF\xBF\xBD");
}

TEST(ConvertWideToUtf8, Kept_convert_01_a_zero_inside_a_given_length_ends_the_result) {
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToUtf8(ZB_W("a\0b"), narrow, 3));
    EXPECT_EQ(bytesOf(narrow), "a");
    EXPECT_TRUE(Convert::WideToUtf8(ZB_W("\0b"), narrow, 2));
    EXPECT_EQ(bytesOf(narrow), "");
    EXPECT_TRUE(Convert::WideToLocal(ZB_W("a\0b"), narrow, 3));
    EXPECT_EQ(bytesOf(narrow), "a");
}

// ---- what all functions share --------------------------------------------------------------------------------------

TEST(Convert, gives_true_and_nothing_for_an_empty_source) {
    for (char const* text : {static_cast<char const*>(nullptr), ""}) {
        WBStr wide = filled<WBStr>();
        EXPECT_TRUE(Convert::Utf8ToWide(text, wide));
        EXPECT_TRUE(wide.empty());
        wide = filled<WBStr>();
        EXPECT_TRUE(Convert::LocalToWide(text, wide));
        EXPECT_TRUE(wide.empty());
        for (std::uint32_t e : {0u, 1u, 2u}) {
            wide = filled<WBStr>();
            EXPECT_TRUE(Convert::ToWide(encoding(e), text, wide));
            EXPECT_TRUE(wide.empty());
        }
        BufStr<255> narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::EncodeMB(Convert::ENC_UTF8, text, Convert::ENC_LOCAL, narrow));
        EXPECT_TRUE(narrow.empty());
        narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::ToLocal(Convert::ENC_OEM, text, narrow));
        EXPECT_TRUE(narrow.empty());
        narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::LocalToUtf8(text, narrow));
        EXPECT_TRUE(narrow.empty());
        narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::Utf8ToLocal(text, narrow));
        EXPECT_TRUE(narrow.empty());
    }
    for (WChar const* text : {static_cast<WChar const*>(nullptr), ZB_W("")}) {
        BufStr<255> narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::WideToUtf8(text, narrow));
        EXPECT_TRUE(narrow.empty());
        narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::WideToLocal(text, narrow));
        EXPECT_TRUE(narrow.empty());
        for (std::uint32_t e : {0u, 1u, 2u}) {
            narrow = filled<BufStr<255>>();
            EXPECT_TRUE(Convert::FromWide(text, encoding(e), narrow));
            EXPECT_TRUE(narrow.empty());
        }
    }
}

TEST(Convert, measures_a_source_of_length_0_in_a_view_too) {
    WBStr wide;
    EXPECT_TRUE(Convert::Utf8ToWide(Str("abc", 0), wide));
    EXPECT_EQ(unitsOf(wide), ZB_W("abc"));
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToUtf8(WStr(ZB_W("abc"), 0), narrow));
    EXPECT_EQ(bytesOf(narrow), "abc");
    EXPECT_TRUE(Convert::EncodeMB(Convert::ENC_UTF8, Str("abc", 0), Convert::ENC_LOCAL, narrow));
    EXPECT_EQ(bytesOf(narrow), "abc");
}

TEST(Convert, refuses_encodings_that_do_not_exist) {
    for (std::uint32_t e : {3u, 4u, 77u, 0xFFFFFFFFu}) {
        WBStr wide = filled<WBStr>();
        EXPECT_FALSE(Convert::ToWide(encoding(e), "abc", wide));
        EXPECT_TRUE(wide.empty());
        EXPECT_FALSE(Convert::ToWide(encoding(e), "", wide));
        BufStr<255> narrow = filled<BufStr<255>>();
        EXPECT_FALSE(Convert::FromWide(ZB_W("abc"), encoding(e), narrow));
        EXPECT_TRUE(narrow.empty());
        EXPECT_FALSE(Convert::FromWide(ZB_W(""), encoding(e), narrow));
    }
}

TEST(Convert, refuses_sources_longer_than_the_system_can_count) {
    WBStr wide = filled<WBStr>();
    EXPECT_FALSE(Convert::Utf8ToWide("abc", wide, 0x80000000));
    EXPECT_FALSE(Convert::Utf8ToWide("abc", wide, 0x100000003)); // would be 3 in 32 bits
    EXPECT_TRUE(wide.empty());
    BufStr<255> narrow = filled<BufStr<255>>();
    EXPECT_FALSE(Convert::WideToUtf8(ZB_W("abc"), narrow, 0x100000003));
    EXPECT_TRUE(narrow.empty());
}

TEST(Convert, grows_its_output_by_exactly_what_is_needed) {
    std::string const text(300, 'a');
    WBStr wide;
    EXPECT_TRUE(Convert::Utf8ToWide(text, wide));
    EXPECT_EQ(wide.size(), 300u);
    EXPECT_EQ(wide.sizeBuf(), 301u);
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToUtf8(wide, narrow));
    EXPECT_EQ(bytesOf(narrow), text);
    EXPECT_EQ(narrow.sizeBuf(), 301u);

    WBStr inlined; // 254 units and one more fit the inline area
    EXPECT_TRUE(Convert::Utf8ToWide(std::string(254, 'a'), inlined));
    EXPECT_EQ(inlined.sizeBuf(), 255u);
    EXPECT_TRUE(Convert::Utf8ToWide(std::string(255, 'a'), inlined));
    EXPECT_EQ(inlined.sizeBuf(), 256u);

    std::string euros; // 750 bytes are 250 units, which fit
    for (int i = 0; i < 250; ++i) euros += "\xE2\x82\xAC";
    WBStr fits;
    EXPECT_TRUE(Convert::Utf8ToWide(euros, fits));
    EXPECT_EQ(fits.size(), 250u);
    EXPECT_EQ(fits.sizeBuf(), 255u);
    BufStr<255> grown;
    EXPECT_TRUE(Convert::WideToUtf8(fits, grown));
    EXPECT_EQ(bytesOf(grown), euros);
    EXPECT_EQ(grown.sizeBuf(), 751u);
}

TEST(Convert, leaves_its_output_as_small_as_it_was_where_a_long_text_is_invalid) {
    for (std::size_t size : {200U, 254U, 255U, 300U, 5000U}) {
        WBStr out;
        EXPECT_FALSE(Convert::Utf8ToWide(std::string(size, 'a') + "\xC3", out)) << size;
        EXPECT_EQ(out.size(), 0U) << size;
        EXPECT_EQ(out.sizeBuf(), 255U) << size;
        out.extendBuf(280);
        EXPECT_FALSE(Convert::Utf8ToWide(std::string(size, 'a') + "\xC3", out)) << size;
        EXPECT_EQ(out.sizeBuf(), 280U) << size;
    }
}

TEST(Convert, keeps_a_large_enough_buffer) {
    WBStr wide = filled<WBStr>();
    std::uint64_t const capacity = wide.sizeBuf();
    WChar const* const block = wide.wstr();
    EXPECT_TRUE(Convert::Utf8ToWide("abc", wide));
    EXPECT_EQ(wide.sizeBuf(), capacity);
    EXPECT_EQ(wide.wstr(), block);
}

// ---- narrow to narrow ----------------------------------------------------------------------------------------------

TEST(ConvertEncodeMB, copies_between_equal_encodings) {
    for (std::uint32_t e : {0u, 1u, 2u, 9u}) {
        BufStr<255> narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::EncodeMB(encoding(e), "\xC3", encoding(e), narrow));
        EXPECT_EQ(bytesOf(narrow), "\xC3");
    }
}

TEST(ConvertEncodeMB, Kept_convert_02_copies_what_it_cannot_convert) {
    struct Case {
        Row row;
        std::uint32_t from, to;
        char const* text;
    };
    for (Case const& c : {
             Case{{}, 0, 1, "broken \xC3"},
             Case{{}, 0, 2, "broken \xFF\xFE"},
             Case{{}, 3, 0, "a\xE4"},
             Case{{}, 0, 3, "a\xE4"},
             Case{{}, 1, 0xFFFFFFFF, "a\xE4"},
         }) {
        SCOPED_TRACE(c.row);
        BufStr<255> narrow = filled<BufStr<255>>();
        EXPECT_TRUE(Convert::EncodeMB(encoding(c.from), c.text, encoding(c.to), narrow));
        EXPECT_EQ(bytesOf(narrow), c.text);
        EXPECT_TRUE(Convert::EncodeMB(encoding(c.from), Str(c.text), encoding(c.to), narrow));
        EXPECT_EQ(bytesOf(narrow), c.text);
    }
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::ToLocal(encoding(5), "a\xE4", narrow));
    EXPECT_EQ(bytesOf(narrow), "a\xE4");
}

TEST(ConvertLocal, leaves_nothing_when_either_step_fails) {
    BufStr<255> narrow = filled<BufStr<255>>();
    EXPECT_FALSE(Convert::Utf8ToLocal("broken \xC3", narrow));
    EXPECT_TRUE(narrow.empty());
}

TEST(ConvertLocal, takes_ascii_both_ways) {
    WBStr wide;
    BufStr<255> narrow;
    for (std::uint32_t e : {0u, 1u, 2u}) {
        EXPECT_TRUE(Convert::ToWide(encoding(e), "Page 1 of 2.", wide));
        EXPECT_EQ(unitsOf(wide), ZB_W("Page 1 of 2."));
        EXPECT_TRUE(Convert::FromWide(wide, encoding(e), narrow));
        EXPECT_EQ(bytesOf(narrow), "Page 1 of 2.");
    }
    EXPECT_TRUE(Convert::LocalToUtf8("Page 1", narrow));
    EXPECT_EQ(bytesOf(narrow), "Page 1");
    EXPECT_TRUE(Convert::Utf8ToLocal("Page 1", narrow));
    EXPECT_EQ(bytesOf(narrow), "Page 1");
}

// ---- against the second reading ------------------------------------------------------------------------------------

namespace {

std::uint32_t randomCharacter(std::mt19937_64& random) {
    static constexpr std::uint32_t limits[] = {0x80, 0x80, 0x800, 0x10000, 0x110000};
    for (;;) {
        std::uint32_t const c = static_cast<std::uint32_t>(random() % limits[random() % 5]);
        if (c != 0 && (c < 0xD800 || c > 0xDFFF)) return c;
    }
}

/// Runs of the same kind of character, as the conversions treat those apart.
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
