// The locale's character set. Its counterpart on Windows is in convert_code_pages_win_test.cpp.

#include "basis/text/charset_posix.h"

#include "tests/support/child.h"
#include "tests/support/table.h"
#include "tests/text/convert_check.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <string>
#include <thread>
#include <utility>
#include <vector>

using namespace ZOR_Basis;
using reference::WideText;

namespace {

/// Selects a character set for its own lifetime.
class LocalCharset {
public:
    explicit LocalCharset(char const* name) { Charset::setLocal(name); }
    ~LocalCharset() { Charset::setLocal(nullptr); }
};

struct LocalText {
    Row row;
    char const* charset;
    std::string local;
    WideText wide;
};

LocalText const LOCAL_TEXTS[] = {
    {{}, "ISO-8859-1", "\xE4\xFF", ZB_W("\u00E4\u00FF")},
    {{}, "ISO-8859-15", "\xA4", ZB_W("\u20AC")},
    {{}, "KOI8-R", "\xC1\xC2", ZB_W("\u0430\u0431")},
    {{}, "CP437", "\x84\xE1", ZB_W("\u00E4\u00DF")},
    {{},
     "SHIFT_JIS",
     "\x82\xA0"
     "a",
     ZB_W("\u3042"
          "a")},
    {{}, "EUC-JP", "\xA4\xA2", ZB_W("\u3042")},
    {{}, "ISO-2022-JP", "\x1B$B$\"\x1B(B", ZB_W("\u3042")},
    {{}, "GB18030", "\x94\x39\xFC\x36", {0xD83D, 0xDE00}},
    {{}, "utf8", "\xC3\xA4", ZB_W("\u00E4")},
};

} // namespace

TEST(CharsetPosix, converts_by_the_character_set) {
    for (LocalText const& c : LOCAL_TEXTS) {
        SCOPED_TRACE(c.row);
        LocalCharset const charset(c.charset);
        WBStr wide;
        BufStr<255> narrow;
        for (Convert::Encoding e : {Convert::ENC_LOCAL, Convert::ENC_OEM}) {
            EXPECT_TRUE(Convert::ToWide(e, c.local, wide));
            EXPECT_EQ(unitsOf(wide), c.wide);
            EXPECT_TRUE(Convert::FromWide(wide, e, narrow));
            EXPECT_EQ(bytesOf(narrow), c.local);
        }
        EXPECT_TRUE(Convert::LocalToUtf8(c.local, narrow));
        EXPECT_EQ(bytesOf(narrow), reference::utf8(reference::characters(c.wide)));
        BufStr<255> back;
        EXPECT_TRUE(Convert::Utf8ToLocal(narrow, back));
        EXPECT_EQ(bytesOf(back), c.local);
        EXPECT_TRUE(Convert::EncodeMB(Convert::ENC_OEM, "any \xE4", Convert::ENC_LOCAL, back));
        EXPECT_EQ(bytesOf(back), "any \xE4") << "one set: nothing is converted";
    }
}

TEST(CharsetPosix, refuses_what_is_invalid_in_the_set) {
    struct Case {
        Row row;
        char const* charset;
        char const* local;
    };
    for (Case const& c : {
             Case{{}, "ANSI_X3.4-1968", "a\xE4"}, Case{{}, "SHIFT_JIS", "a\x82"}, // cut
             Case{{},
                  "EUC-JP",
                  "\xA4"
                  "a"},                      //
             Case{{}, "ISO-8859-3", "\xA5"}, // a byte without a character
             Case{{}, "UTF-8", "\xE4"},      //
             Case{{}, "NO-SUCH-SET", "a"},   //
         }) {
        SCOPED_TRACE(c.row);
        LocalCharset const charset(c.charset);
        for (std::string const& before : {std::string(), std::string(2000, 'x')}) {
            WBStr wide;
            EXPECT_FALSE(Convert::LocalToWide(before + c.local, wide));
            EXPECT_TRUE(wide.empty());
            BufStr<255> narrow;
            EXPECT_FALSE(Convert::LocalToUtf8(before + c.local, narrow));
            EXPECT_TRUE(narrow.empty());
            EXPECT_TRUE(Convert::EncodeMB(Convert::ENC_LOCAL, before + c.local, Convert::ENC_UTF8, narrow));
            EXPECT_EQ(bytesOf(narrow), before + c.local);
        }
    }
}

TEST(CharsetPosix, puts_a_question_mark_for_what_the_set_lacks) {
    struct Case {
        Row row;
        char const* charset;
        WideText wide;
        std::string expected;
    };
    for (Case const& c : {
             Case{{}, "ISO-8859-1", ZB_W("a\u20ACb"), "a?b"},
             Case{{}, "ISO-8859-1", {0xD83D, 0xDE00, 'b'}, "?b"}, // one for a pair
             Case{{}, "ISO-8859-1", {'a', 0xD800, 'b'}, "a?b"},   // half a pair becomes U+FFFD, which is lacking
             Case{{}, "ISO-8859-1", {'a', 0xDC00}, "a?"},
             Case{{}, "ISO-8859-1", {'a', 0xD800}, "a?"},
             Case{{},
                  "GB18030",
                  {'a', 0xD800, 'b'},
                  "a\x84\x31\xA4\x37"
                  "b"}, // here it is not
             Case{{}, "ANSI_X3.4-1968", ZB_W("\u00E4"), "?"},
             Case{{}, "ISO-2022-JP", ZB_W("\u3042\u20AC\u3042"), "\x1B$B$\"\x1B(B?\x1B$B$\"\x1B(B"},
         }) {
        SCOPED_TRACE(c.row);
        LocalCharset const charset(c.charset);
        BufStr<255> narrow;
        EXPECT_TRUE(Convert::WideToLocal(c.wide.c_str(), narrow, c.wide.size()));
        EXPECT_EQ(bytesOf(narrow), c.expected);
    }
}

TEST(CharsetPosix, fails_for_a_set_that_the_system_does_not_know) {
    LocalCharset const charset("NO-SUCH-SET");
    BufStr<255> narrow("x");
    EXPECT_FALSE(Convert::WideToLocal(ZB_W("a"), narrow));
    EXPECT_TRUE(narrow.empty());
}

TEST(CharsetPosix, grows_its_output_for_long_text) {
    LocalCharset const charset("KOI8-R");
    std::string const local(5000, '\xC1');
    WBStr wide;
    EXPECT_TRUE(Convert::LocalToWide(local, wide));
    EXPECT_EQ(unitsOf(wide), WideText(5000, 0x430));
    EXPECT_EQ(wide.sizeBuf(), 5001u);
    BufStr<255> narrow;
    EXPECT_TRUE(Convert::WideToLocal(wide, narrow));
    EXPECT_EQ(bytesOf(narrow), local);
    EXPECT_EQ(narrow.sizeBuf(), 5001u);
}

TEST(CharsetPosix, converts_on_several_threads_at_once) {
    LocalCharset const charset("KOI8-R");
    auto work = [] {
        for (int i = 0; i < 2000; ++i) {
            WBStr wide;
            BufStr<255> narrow;
            ASSERT_TRUE(Convert::LocalToWide("\xC1\xC2", wide));
            ASSERT_TRUE(Convert::WideToLocal(wide, narrow));
            ASSERT_EQ(bytesOf(narrow), "\xC1\xC2");
        }
    };
    std::thread one(work);
    std::thread other(work);
    one.join();
    other.join();
}

// ---- the environment, each in a process of its own ------------------------------------------------------------------

namespace {

using Environment = std::vector<std::pair<std::string, std::string>>;

/// Runs `locale_child` in an environment. \return its local text in UTF-8, or "invalid"
std::string childUnder(Environment const& environment, std::string const& hexText) {
    Child child{"locale_child", {hexText}, {{"LC_ALL", ""}, {"LC_CTYPE", ""}, {"LANG", ""}}, ""};
    // The C library leaks what it allocates for LOCPATH.
    child.environment.emplace_back("ASAN_OPTIONS", "detect_leaks=0");
    child.environment.insert(child.environment.end(), environment.begin(), environment.end());
    ChildResult const result = run(child);
    EXPECT_EQ(result.exitCode, 0);
    return result.output;
}

} // namespace

TEST(CharsetPosix, takes_the_character_set_from_the_environment) {
    struct Case {
        Row row;
        Environment environment;
        char const* hexText;
        char const* expected;
    };
    for (Case const& c : {
             Case{{}, {{"LC_ALL", "C.UTF-8"}}, "c3a4", "c3a4"},
             Case{{}, {{"LC_ALL", "C.UTF-8"}}, "e4", "invalid"},
             Case{{}, {{"LC_ALL", "C"}}, "e4", "invalid"},
             Case{{}, {}, "41", "41"},
             Case{{}, {{"LANG", "C.UTF-8"}}, "c3a4", "c3a4"},
             Case{{}, {{"LC_ALL", "C"}, {"LANG", "C.UTF-8"}}, "c3a4", "invalid"},
             // The name of a locale that is not installed states its character set.
             Case{{}, {{"LC_ALL", "xx_XX.ISO-8859-15"}}, "a4", "e282ac"},
             Case{{}, {{"LC_CTYPE", "xx_XX.KOI8-R@modifier"}, {"LANG", "C"}}, "c1", "d0b0"},
             Case{{}, {{"LANG", "xx_XX"}}, "e4", "invalid"},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(childUnder(c.environment, c.hexText), c.expected);
    }
}

TEST(CharsetPosix, takes_the_character_set_of_an_installed_locale_whatever_its_name) {
    namespace fs = std::filesystem;
    fs::path const folder = fs::temp_directory_path() / ("zb_locale_" + std::to_string(::getpid()));
    fs::create_directories(folder);
    std::string const make = "localedef -f KOI8-R -i ru_RU " + (folder / "zb_test").string() + " 2>/dev/null";
    ASSERT_EQ(std::system(make.c_str()), 0) << "the package `locales` has the sources";
    EXPECT_EQ(childUnder({{"LOCPATH", folder.string()}, {"LC_ALL", "zb_test"}}, "c1"), "d0b0");
    fs::remove_all(folder);
}
