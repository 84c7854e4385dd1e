// Code pages of Windows. Their counterpart is in charset_posix_test.cpp.

#include "basis/platform/windows_api_win.h"

#include "tests/support/table.h"
#include "tests/text/convert_check.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

TEST(ConvertCodePagesWin, are_those_that_the_tables_below_are_for) {
    EXPECT_EQ(GetACP(), 1252u);
    EXPECT_EQ(GetOEMCP(), 437u);
}

TEST(ConvertCodePagesWin, convert_both_ways) {
    struct Case {
        Row row;
        Convert::Encoding encoding;
        char const* narrow;
        wchar_t const* wide;
        char const* utf8;
    };
    for (Case const& c : {
             Case{{}, Convert::ENC_LOCAL, "\xE4\x80", L"\u00E4\u20AC", "\xC3\xA4\xE2\x82\xAC"},
             Case{{}, Convert::ENC_LOCAL, "\x99", L"\u2122", "\xE2\x84\xA2"},
             Case{{}, Convert::ENC_OEM, "\x84\xE1", L"\u00E4\u00DF", "\xC3\xA4\xC3\x9F"},
             Case{{}, Convert::ENC_OEM, "\xB0", L"\u2591", "\xE2\x96\x91"},
         }) {
        SCOPED_TRACE(c.row);
        WBStr wide;
        EXPECT_TRUE(Convert::ToWide(c.encoding, c.narrow, wide));
        EXPECT_EQ(unitsOf(wide), c.wide);
        BufStr<255> narrow;
        EXPECT_TRUE(Convert::FromWide(wide, c.encoding, narrow));
        EXPECT_EQ(bytesOf(narrow), c.narrow);
        EXPECT_TRUE(Convert::EncodeMB(c.encoding, c.narrow, Convert::ENC_UTF8, narrow));
        EXPECT_EQ(bytesOf(narrow), c.utf8);
        EXPECT_TRUE(Convert::EncodeMB(Convert::ENC_UTF8, c.utf8, c.encoding, narrow));
        EXPECT_EQ(bytesOf(narrow), c.narrow);
    }
}

TEST(ConvertCodePagesWin, go_from_one_page_to_the_other) {
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::EncodeMB(Convert::ENC_OEM, "\x84", Convert::ENC_LOCAL, narrow));
    EXPECT_EQ(bytesOf(narrow), "\xE4");
    EXPECT_TRUE(Convert::EncodeMB(Convert::ENC_LOCAL, "\xE4", Convert::ENC_OEM, narrow));
    EXPECT_EQ(bytesOf(narrow), "\x84");
    EXPECT_TRUE(Convert::ToLocal(Convert::ENC_OEM, "\x81", narrow));
    EXPECT_EQ(bytesOf(narrow), "\xFC");
    EXPECT_TRUE(Convert::LocalToUtf8("\xFC", narrow));
    EXPECT_EQ(bytesOf(narrow), "\xC3\xBC");
    EXPECT_TRUE(Convert::Utf8ToLocal("\xC3\xBC", narrow));
    EXPECT_EQ(bytesOf(narrow), "\xFC");
}

TEST(ConvertCodePagesWin, put_a_default_for_what_they_lack) {
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToLocal(L"a\u3042z", narrow));
    EXPECT_EQ(bytesOf(narrow), "a?z");
    EXPECT_TRUE(Convert::FromWide(L"a\u3042z", Convert::ENC_OEM, narrow));
    EXPECT_EQ(bytesOf(narrow), "a?z");
}

TEST(ConvertCodePagesWin, refuse_a_byte_without_a_character) {
    WBStr wide;
    // The system's code page 1252 maps every byte, so only the multi-byte path can fail, through UTF-8.
    EXPECT_TRUE(Convert::LocalToWide("\x81", wide));
    EXPECT_EQ(wide.size(), 1u);
    EXPECT_FALSE(Convert::ToWide(Convert::ENC_UTF8, "\x81", wide));
    EXPECT_TRUE(wide.empty());
}
