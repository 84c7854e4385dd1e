// Links, seen by narrow and by wide paths.

#include <zor_basis/files.h>

#include "tests/files/wide_names_posix.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

using namespace ZOR_Basis;

namespace {

struct DirIteratorLinksPosix : testing::Test {
    std::string at(std::string const& name) const { return scratch / name; }
    void link(std::string const& target, std::string const& name) const {
        ASSERT_EQ(symlink(target.c_str(), at(name).c_str()), 0);
    }
    Scratch scratch;
};

} // namespace

TEST_F(DirIteratorLinksPosix, are_links_by_narrow_paths_and_what_they_lead_to_by_wide_ones) {
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

TEST_F(DirIteratorLinksPosix, are_listed_as_what_they_lead_to) {
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

TEST_F(DirIteratorLinksPosix, have_their_own_size_and_time_where_they_lead_to_nothing) {
    link("nowhere", "to-nothing");
    struct timespec const times[2] = {{1'000'000'000, 0}, {1'234'567'890, 0}};
    ASSERT_EQ(utimensat(AT_FDCWD, at("to-nothing").c_str(), times, AT_SYMLINK_NOFOLLOW), 0);
    DirIteratorW list(LOOK_FILES, wideOf(scratch.path()).c_str());
    ASSERT_NE(list->next(), nullptr);
    EXPECT_TRUE(list->isFile());
    EXPECT_EQ(list->size(), 7u) << "the length of the name that it holds";
    EXPECT_EQ(list->time(), 1'234'567'890);
    EXPECT_EQ(list->next(), nullptr);
}

TEST_F(DirIteratorLinksPosix, to_directories_are_directories_to_build_upon) {
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

TEST_F(DirIteratorLinksPosix, are_removed_themselves) {
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

TEST_F(DirIteratorLinksPosix, are_entries_that_are_no_files) {
    put(at("file"), "12345");
    link("file", "to-file");
    FileEntry entry(Str(scratch.path()), "to-file", 9);
    EXPECT_EQ(entry.getType(), FStat::ST_LINK);
    EXPECT_EQ(entry.getSize(), 0u);
    EXPECT_EQ(entry.getTime(), 9);
    EXPECT_FALSE(entry.Refresh());
}
