// Names that only Linux has: bytes that are not UTF-8, long paths and long names.

#include <zor_basis/files.h>

#include "tests/files/wide_names_posix.h"
#include "tests/support/random_steps.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cstring>
#include <memory>

using namespace ZOR_Basis;

TEST(OsPathPosix, turn_to_wide_text_and_back) {
    struct Case {
        Row row;
        std::string name;
        WideText wide;
    };
    for (Case const& c : {
             Case{{}, "", u""},
             Case{{}, "plain", u"plain"},
             Case{{}, "\xC3\xA4\xE2\x82\xAC", u"\u00E4\u20AC"},
             Case{{}, "\xF0\x9F\x96\xA8", u"\xD83D\xDDA8"},
             Case{{}, "\xE4", {0xDCE4}},
             Case{{}, "a\xE4z", {'a', 0xDCE4, 'z'}},
             Case{{}, "\xFF\xFE", {0xDCFF, 0xDCFE}},
             Case{{}, "\xC3", {0xDCC3}},
             Case{{}, "\xE2\x82", {0xDCE2, 0xDC82}},
             Case{{}, "\x80", {0xDC80}},
             Case{{}, "\xC0\xAF", {0xDCC0, 0xDCAF}},
             Case{{}, "\xED\xA0\x80", {0xDCED, 0xDCA0, 0xDC80}},
             // The UTF-8 form of a stray byte's own unit is no UTF-8.
             Case{{}, "\xED\xB3\xA4", {0xDCED, 0xDCB3, 0xDCA4}},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(wideOf(c.name), c.wide);
        EXPECT_EQ(narrowOf(c.wide), c.name);
    }
    EXPECT_EQ(narrowOf({0xDC00}), "\xEF\xBF\xBD") << "no stray byte";
    EXPECT_EQ(narrowOf({0xD800}), "\xEF\xBF\xBD");
    BufStr<255> narrow("before");
    narrowName(nullptr, narrow);
    EXPECT_TRUE(narrow.empty());
}

TEST(OsPathPosix, keep_a_stray_byte_where_the_room_inside_the_text_ends) {
    for (std::size_t before = 250; before <= 260; ++before) {
        for (char const* behind : {"", "z", "\xFF", "\xC3\xA4"}) {
            std::string const name = std::string(before, 'n') + "\xE4" + behind;
            WideText wide(before, u'n');
            wide += static_cast<WChar>(0xDCE4);
            ASSERT_EQ(wideOf(name).substr(0, before + 1), wide) << before;
            ASSERT_EQ(narrowOf(wideOf(name)), name) << before << " behind " << behind;
            BufStr<255> narrow;
            narrowName(wideOf(name).c_str(), narrow);
            EXPECT_EQ(narrow.size(), name.size());
            EXPECT_GE(narrow.sizeBuf(), name.size());
        }
    }
}

TEST(OsPathPosix, survive_the_way_to_wide_text_whatever_their_bytes) {
    auto random = randomSource();
    for (std::uint64_t step = randomSteps(20'000); step > 0; --step) {
        std::string name;
        for (std::uint64_t n = random() % 12; n > 0; --n) {
            // Mostly the bytes that make and break characters.
            static char const bytes[] = "a\xC3\xA4\xE2\x82\xAC\xF0\x9F\x96\xA8\xED\xA0\xB0\xFF";
            name.push_back(random() % 4 != 0 ? bytes[random() % (sizeof bytes - 1)]
                                             : static_cast<char>(1 + random() % 255));
        }
        ASSERT_EQ(narrowOf(wideOf(name)), name);
    }
}

TEST(OsPathPosix, become_paths_with_slashes_for_the_system) {
    EXPECT_STREQ(OsPath("a\\b/c\\"), "a/b/c/");
    EXPECT_STREQ(OsPath("a/b"), "a/b");
    EXPECT_STREQ(OsPath(static_cast<char const*>(nullptr)), "");
    EXPECT_STREQ(OsPath(u"a\\b"), "a/b");
    EXPECT_STREQ(OsPath(static_cast<WChar const*>(nullptr)), "");
}

TEST(OsPathPosix, list_and_open_what_is_not_utf8) {
    Scratch scratch;
    std::string const odd = "odd \xE4\xFF";
    put(scratch / odd, "123");
    makeFolder(scratch / "\xE4");
    EXPECT_EQ(namesIn(scratch.path()), (std::set<WideText>{wideOf(odd), wideOf("\xE4")}));
    WideText const wide = wideOf(scratch / odd);
    EXPECT_EQ(FStat(wide.c_str()).size(), 3u);
    EXPECT_TRUE(File(wide.c_str(), 0x31).isOpen());
    EXPECT_EQ(FStat::size((scratch / odd).c_str()), 3u);
    EXPECT_TRUE(Dir::NewW(wideOf(scratch / "\xE4/\xC3").c_str(), false));
    EXPECT_TRUE(FStat::isDir((scratch / "\xE4/\xC3").c_str()));
    EXPECT_EQ(namesIn(scratch / "\xE4"), (std::set<WideText>{{0xDCC3}}));
}

TEST(OsPathPosix, may_have_255_bytes) {
    Scratch scratch;
    std::string const name(255, 'n');
    std::string umlauts;
    while (umlauts.size() < 254) umlauts += "\xC3\xA4";
    put(scratch / name, "1");
    put(scratch / umlauts, "22");
    EXPECT_EQ(namesIn(scratch.path()), (std::set<WideText>{wideOf(name), wideOf(umlauts)}));
    EXPECT_EQ(FileEntry(Str(scratch.path()), umlauts.c_str(), 0).getSize(), 2u);
    EXPECT_TRUE(File::Rem((scratch / name).c_str(), true, false));
    std::string const longer(256, 'n');
    EXPECT_FALSE(File::New((scratch / longer).c_str(), false));
}

TEST(OsPathPosix, may_lie_deeper_than_1024_characters) {
    Scratch scratch;
    std::string path = scratch.path();
    while (path.size() < 2000) path += "/a folder of a deep tree";
    std::string const file = path + "/file";
    EXPECT_TRUE(Dir::NewFor(file.c_str()));
    EXPECT_TRUE(File::New(file.c_str(), false));
    EXPECT_TRUE(FStat::isFile(file.c_str()));
    EXPECT_TRUE(FStat(wideOf(file).c_str()).isFile());
    EXPECT_EQ(namesIn(path), std::set<WideText>{u"file"});
    EXPECT_TRUE(File(wideOf(file).c_str(), 0x3A).isOpen());
    EXPECT_TRUE(File::Copy((file + "2").c_str(), file.c_str(), false, false));
    EXPECT_TRUE(Dir::NewW(wideOf(path + "/x/y").c_str(), true));
    FPath existing;
    FPath rest;
    EXPECT_TRUE(Dir::SplitCheck((path + "/no/such").c_str(), existing, rest));
    EXPECT_STREQ(existing.c_str(), path.c_str());
    EXPECT_STREQ(rest.c_str(), "no/such");
    EXPECT_TRUE(Dir::Rem((scratch / "a folder of a deep tree").c_str(), true, false));
    EXPECT_EQ(scratch.content(), Names{});
}
