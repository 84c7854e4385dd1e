#include "tests/text/convert_check.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;
using reference::WideText;

TEST(Convert, breathes) {
    WBStr wide;
    EXPECT_TRUE(Convert::Utf8ToWide("\xC3\xA4pfel", wide));
    EXPECT_EQ(unitsOf(wide), ZB_W("\u00E4pfel"));
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToUtf8(wide, narrow));
    EXPECT_EQ(bytesOf(narrow), "\xC3\xA4pfel");
}

namespace {

/// \return whether a conversion succeeds and empties its output
template <class Text, class Conversion>
bool empties(Conversion convert) {
    Text text = filled<Text>();
    return convert(text) && text.empty();
}

} // namespace

TEST(Convert, gives_true_and_nothing_for_an_empty_narrow_source) {
    for (char const* none : {static_cast<char const*>(nullptr), ""}) {
        EXPECT_TRUE(empties<WBStr>([none](WBStr& out) { return Convert::Utf8ToWide(none, out); }));
        EXPECT_TRUE(empties<WBStr>([none](WBStr& out) { return Convert::LocalToWide(none, out); }));
        for (std::uint32_t e : {0u, 1u, 2u}) {
            EXPECT_TRUE(empties<WBStr>([none, e](WBStr& out) { return Convert::ToWide(encoding(e), none, out); }));
        }
        using Narrow = BufStr<255>;
        EXPECT_TRUE(empties<Narrow>(
            [none](Narrow& out) { return Convert::EncodeMB(Convert::ENC_UTF8, none, Convert::ENC_LOCAL, out); }));
        EXPECT_TRUE(empties<Narrow>([none](Narrow& out) { return Convert::ToLocal(Convert::ENC_OEM, none, out); }));
        EXPECT_TRUE(empties<Narrow>([none](Narrow& out) { return Convert::LocalToUtf8(none, out); }));
        EXPECT_TRUE(empties<Narrow>([none](Narrow& out) { return Convert::Utf8ToLocal(none, out); }));
    }
}

TEST(Convert, gives_true_and_nothing_for_an_empty_wide_source) {
    using Narrow = BufStr<255>;
    for (WChar const* none : {static_cast<WChar const*>(nullptr), ZB_W("")}) {
        EXPECT_TRUE(empties<Narrow>([none](Narrow& out) { return Convert::WideToUtf8(none, out); }));
        EXPECT_TRUE(empties<Narrow>([none](Narrow& out) { return Convert::WideToLocal(none, out); }));
        for (std::uint32_t e : {0u, 1u, 2u}) {
            EXPECT_TRUE(empties<Narrow>([none, e](Narrow& out) { return Convert::FromWide(none, encoding(e), out); }));
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

// ---- narrow to narrow -----------------------------------------------------------------------------------------------

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
