// Names that only Linux has: links, bytes that are no UTF-8, long paths and long names. The sibling is
// names_win_test.cpp.

#include <zor_basis/files.h>

#include "basis/files/os_path_posix.h"
#include "tests/support/random_steps.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <cstring>
#include <memory>
#include <set>

using namespace ZOR_Basis;

namespace {

using WideText = std::basic_string<WChar>;

WideText wideOf(std::string const& name) {
    WBStr wide;
    wideName(name.c_str(), wide);
    return {wide.wstr(), wide.size()};
}
std::string narrowOf(WideText const& name) {
    BufStr<255> narrow;
    narrowName(name.c_str(), narrow);
    return {narrow.c_str(), narrow.size()};
}

struct Links : testing::Test {
    std::string at(std::string const& name) const { return scratch / name; }
    void link(std::string const& target, std::string const& name) const {
        ASSERT_EQ(symlink(target.c_str(), at(name).c_str()), 0);
    }
    Scratch scratch;
};

std::set<WideText> namesIn(std::string const& folder, LookForType type = LOOK_ALL) {
    std::set<WideText> names;
    DirIteratorW list(type, wideOf(folder).c_str());
    while (WChar const* name = list->next()) names.insert(name);
    EXPECT_EQ(list->lastError(), 18u);
    return names;
}

} // namespace

TEST(NamesPosix, turn_to_wide_text_and_back) {
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

TEST(NamesPosix, survive_the_way_to_wide_text_whatever_their_bytes) {
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

TEST(NamesPosix, become_paths_with_slashes_for_the_system) {
    EXPECT_STREQ(OsPath("a\\b/c\\"), "a/b/c/");
    EXPECT_STREQ(OsPath("a/b"), "a/b");
    EXPECT_STREQ(OsPath(static_cast<char const*>(nullptr)), "");
    EXPECT_STREQ(OsPath(u"a\\b"), "a/b");
    EXPECT_STREQ(OsPath(static_cast<WChar const*>(nullptr)), "");
}

TEST(NamesPosix, list_and_open_what_is_not_utf8) {
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

TEST(NamesPosix, may_have_255_bytes) {
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

TEST(NamesPosix, may_lie_deeper_than_1024_characters) {
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

TEST_F(Links, are_links_by_narrow_paths_and_what_they_lead_to_by_wide_ones) {
    put(at("file"), "12345");
    makeFolder(at("folder"));
    link("file", "to-file");
    link("folder", "to-folder");
    link("nowhere", "to-nothing");
    for (char const* name : {"to-file", "to-folder", "to-nothing"}) {
        FStat const entry(at(name).c_str());
        EXPECT_EQ(entry.type(), FStat::ST_LINK) << name;
        EXPECT_TRUE(entry.exist());
        EXPECT_FALSE(entry.isFile());
        EXPECT_FALSE(entry.isDir());
        EXPECT_TRUE(Dir::Exist(at(name).c_str()));
    }
    EXPECT_EQ(FStat(wideOf(at("to-file")).c_str()).type(), FStat::ST_FILE);
    EXPECT_EQ(FStat(wideOf(at("to-file")).c_str()).size(), 5u);
    EXPECT_EQ(FStat(wideOf(at("to-folder")).c_str()).type(), FStat::ST_DIR);
    EXPECT_FALSE(FStat(wideOf(at("to-nothing")).c_str()).exist());
    EXPECT_EQ(FStat("/dev/null").type(), FStat::ST_OTHER);
    EXPECT_EQ(FStat(u"/dev/null").type(), FStat::ST_FILE);
}

TEST_F(Links, are_listed_as_what_they_lead_to) {
    put(at("file"), "12345");
    makeFolder(at("folder"));
    link("file", "to-file");
    link("folder", "to-folder");
    link("nowhere", "to-nothing");
    EXPECT_EQ(namesIn(scratch.path(), LOOK_DIRS), (std::set<WideText>{u"folder", u"to-folder"}));
    EXPECT_EQ(namesIn(scratch.path(), LOOK_FILES), (std::set<WideText>{u"file", u"to-file", u"to-nothing"}));
    DirIteratorW list(LOOK_FILES, wideOf(scratch.path()).c_str());
    list->setWildCard(u"to-file");
    ASSERT_NE(list->next(), nullptr);
    EXPECT_EQ(list->size(), 5u);
}

TEST_F(Links, to_directories_are_directories_to_build_upon) {
    makeFolder(at("folder"));
    put(at("file"), "");
    link("folder", "to-folder");
    link("file", "to-file");
    link("nowhere", "to-nothing");
    EXPECT_TRUE(Dir::New(at("to-folder").c_str(), false));
    EXPECT_TRUE(Dir::New(at("to-folder/a/b").c_str(), true));
    EXPECT_TRUE(Dir::NewFor(at("to-folder/c/file").c_str()));
    EXPECT_EQ(scratch.content("folder"), (Names{"a/", "a/b/", "c/"}));
    EXPECT_FALSE(Dir::New(at("to-file").c_str(), false));
    EXPECT_FALSE(Dir::New(at("to-nothing").c_str(), false));
    EXPECT_TRUE(Dir::NewW(wideOf(at("to-folder")).c_str(), false));
}

TEST_F(Links, are_removed_themselves) {
    makeFolder(at("folder"));
    put(at("folder/kept"), "1");
    link("folder", "to-folder");
    EXPECT_TRUE(Dir::Rem(at("to-folder").c_str(), true, false));
    EXPECT_EQ(scratch.content(), (Names{"folder/", "folder/kept"}));
    link("folder", "to-folder");
    put(at("src"), "new");
    EXPECT_TRUE(File::LinkOrCopy(at("to-folder").c_str(), at("src").c_str(), true, false));
    EXPECT_EQ(textOf(at("to-folder")), "new");
    EXPECT_EQ(textOf(at("folder/kept")), "1");
}

TEST_F(Links, are_entries_that_are_no_files) {
    put(at("file"), "12345");
    link("file", "to-file");
    FileEntry entry(Str(scratch.path()), "to-file", 9);
    EXPECT_EQ(entry.getType(), FStat::ST_LINK);
    EXPECT_EQ(entry.getSize(), 0u);
    EXPECT_EQ(entry.getTime(), 9);
    EXPECT_FALSE(entry.Refresh());
}

TEST(FStatOnLinux, sees_no_directory_in_a_socket_by_a_wide_path) {
    Scratch const scratch;
    std::string const path = scratch / "s";
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    ASSERT_LT(path.size(), sizeof address.sun_path);
    std::strcpy(address.sun_path, path.c_str());
    int const socket = ::socket(AF_UNIX, SOCK_STREAM, 0);
    ASSERT_EQ(::bind(socket, reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
    ::close(socket);
    // The type bits of a socket contain those of a directory.
    EXPECT_EQ(FStat(wideOf(path).c_str()).type(), FStat::ST_FILE);
    EXPECT_EQ(FStat(path.c_str()).type(), FStat::ST_OTHER);
}
