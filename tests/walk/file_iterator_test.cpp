#include <zor_basis/walk/file_iterator.h>

#include "tests/support/table.h"

#include "tests/walk/walked_folder.h"

#include <gtest/gtest.h>

#include <iterator>

using namespace ZOR_Basis;

namespace {

struct FileIteratorInAFolder : WalkedFolder {};

} // namespace

TEST_F(FileIteratorInAFolder, gives_directories_the_size_0) {
    fill();
    Recorder seen;
    EXPECT_TRUE(FileIterator(scratch.path(), LOOK_BOTH, nullptr, nullptr).doIt(&seen, true, false));
    std::multiset<std::string> sizes;
    for (FileEntry const& entry : seen.entries)
        sizes.insert(std::string(entry.getName().c_str()) + " " + std::to_string(entry.getSize()));
    EXPECT_EQ(sizes, (Found{"a.txt 5", "b.dat 0", "d 0", "c.txt 1", "e 0", "f.TXT 1"}));
    for (FileEntry const& entry : seen.entries) EXPECT_GT(entry.getTime(), 0);
}

TEST_F(FileIteratorInAFolder, breathes) {
    fill();
    EXPECT_EQ(walked(LOOK_BOTH, nullptr, true), (Found{"a.txt", "b.dat", "d/", "d/c.txt", "d/e/", "d/e/f.TXT"}));
    expectAllClosed();
}

TEST_F(FileIteratorInAFolder, walks_the_kinds_of_its_type) {
    fill();
    struct Case {
        Row row;
        LookForType type;
        Found shallow;
        Found deep;
    };
    for (Case const& c : {
             Case{{}, LOOK_FILES, {"a.txt", "b.dat"}, {"a.txt", "b.dat", "d/c.txt", "d/e/f.TXT"}},
             Case{{}, LOOK_DIRS, {"d/"}, {"d/", "d/e/"}},
             Case{{}, LOOK_ALL, {"d/"}, {"d/", "d/e/"}},
             Case{{}, LOOK_BOTH, {"a.txt", "b.dat", "d/"}, {"a.txt", "b.dat", "d/", "d/c.txt", "d/e/", "d/e/f.TXT"}},
             Case{{}, LOOK_ALL | LOOK_ANYCASE, {"d/"}, {"d/", "d/e/"}},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(walked(c.type, nullptr, false), c.shallow);
        EXPECT_EQ(walked(c.type, "", true), c.deep);
    }
}

TEST_F(FileIteratorInAFolder, Kept_walk_01_lists_everything_where_a_walk_reports_directories) {
    fill();
    struct Case {
        Row row;
        LookForType type;
        Found flat;
    };
    for (Case const& c : {
             Case{{}, LOOK_ALL, {"a.txt", "b.dat", "d"}},
             Case{{}, LOOK_FILES, {"a.txt", "b.dat"}},
             Case{{}, LOOK_DIRS, {"d"}},
             Case{{}, LOOK_BOTH, {"a.txt", "b.dat", "d"}},
         }) {
        SCOPED_TRACE(c.row);
        FileIterator it(scratch.path().c_str(), c.type, nullptr, nullptr);
        EXPECT_EQ(listed(it), c.flat);
    }
    EXPECT_EQ(walked(LOOK_ALL, nullptr, false), Found{"d/"});
}

TEST_F(FileIteratorInAFolder, fills_in_the_entry) {
    fill();
    Recorder seen;
    FileIterator(Str(scratch.path()), LOOK_FILES, "a*", nullptr).doIt(&seen, false, true);
    ASSERT_EQ(seen.entries.size(), 1u);
    FileEntry const& entry = seen.entries[0];
    FStat const status((scratch / "a.txt").c_str());
    EXPECT_STREQ(entry.getDir(), scratch.path().c_str());
    EXPECT_STREQ(entry.getName(), "a.txt");
    EXPECT_STREQ(entry.getFullPath(), (scratch / "a.txt").c_str());
    EXPECT_EQ(entry.getSize(), 5u);
    EXPECT_EQ(entry.getTime(), status.modified());
    EXPECT_NE(entry.getTime(), 0);
    EXPECT_EQ(entry.getType(), FStat::ST_FILE);
}

TEST_F(FileIteratorInAFolder, Kept_walk_03_passes_over_one_name_in_walks_only) {
    makeFolder(scratch / "d/__MACOS/in");
    makeFolder(scratch / "__MACOS");
    makeFolder(scratch / "__MACOSX");
    put(scratch / "__MACOS/x", "");
    put(scratch / "d/__MACOS/y", "");
    EXPECT_EQ(walked(LOOK_BOTH, nullptr, true), (Found{"__MACOSX/", "d/"}));
    FileIterator it(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr);
    EXPECT_EQ(listed(it), (Found{"__MACOS", "__MACOSX", "d"}));
}

TEST_F(FileIteratorInAFolder, Kept_walk_03_passes_over_a_file_of_that_name) {
    put(scratch / "__MACOS", "");
    put(scratch / "__macos2", "");
    EXPECT_EQ(walked(LOOK_FILES, nullptr, true), Found{"__macos2"});
}

TEST_F(FileIteratorInAFolder, Kept_walk_04_enters_directories_that_do_not_match) {
    fill();
    EXPECT_EQ(walked(LOOK_BOTH, "*.txt", true), (Found{"a.txt", "d/c.txt"}));
    EXPECT_EQ(walked(LOOK_BOTH | LOOK_ANYCASE, "*.tXt", true), (Found{"a.txt", "d/c.txt", "d/e/f.TXT"}));
    OnlyWith condition('f');
    EXPECT_EQ(walked(LOOK_BOTH, nullptr, true, &condition), Found{"d/e/f.TXT"});
}

TEST_F(FileIteratorInAFolder, Kept_walk_06_takes_a_missing_directory_for_an_empty_one) {
    Recorder seen;
    FileIterator it((scratch / "none").c_str(), LOOK_BOTH, nullptr, nullptr);
    EXPECT_TRUE(it.doIt(&seen, true, true));
    EXPECT_TRUE(it.shallowIteration(&seen, true));
    EXPECT_TRUE(it.deepIteration(&seen, true));
    EXPECT_TRUE(it.shallowRide(&seen, true));
    EXPECT_TRUE(it.deepRide(&seen, true));
    EXPECT_TRUE(seen.paths.empty());
    EXPECT_FALSE(it.start(true));
    EXPECT_EQ(it.next(), nullptr);
}

TEST_F(FileIteratorInAFolder, lists_names_flat) {
    fill();
    FileIterator it(Str(scratch.path()), LOOK_FILES | LOOK_ANYCASE, "*.TXT", nullptr);
    EXPECT_EQ(listed(it), Found{"a.txt"}) << "opened by itself, with wildcard and case";
    EXPECT_EQ(listed(it), Found{"a.txt"}) << "and again after the end";
    expectAllClosed();
    ASSERT_TRUE(it.start(false));
    EXPECT_EQ(listed(it), (Found{"a.txt", "b.dat"}));
    ASSERT_TRUE(it.start(true));
    ASSERT_TRUE(it.start(true)) << "a second start closes the first";
    EXPECT_STREQ(it.next(), "a.txt");
    it.finish();
    it.finish();
    expectAllClosed();
    OnlyWith condition('b');
    FileIterator some(scratch.path().c_str(), LOOK_FILES, nullptr, &condition);
    EXPECT_EQ(listed(some), Found{"b.dat"});
    EXPECT_EQ(condition.asked, &some);
}

TEST_F(FileIteratorInAFolder, copies_its_settings_but_not_its_listing) {
    fill();
    {
        FileIterator it(scratch.path().c_str(), LOOK_FILES, "a*", nullptr);
        ASSERT_TRUE(it.start(true));
        FileIterator copy(it);
        EXPECT_STREQ(copy.next(), "a.txt");
        EXPECT_STREQ(it.next(), "a.txt");
        copy = it;
        EXPECT_EQ(it.next(), nullptr);
        EXPECT_STREQ(copy.next(), "a.txt") << "assigning closes and begins again";
    }
    expectAllClosed();
}

TEST_F(FileIteratorInAFolder, takes_every_setting_when_it_is_assigned) {
    fill();
    makeFolder(scratch / "other");
    for (char const* name : {"ax", "ay", "bx"}) put(scratch / (std::string("other/") + name), "");
    OnlyWith condition('x');
    FileIterator it(scratch.path().c_str(), LOOK_DIRS, "d*", nullptr);
    it = FileIterator((scratch / "other").c_str(), LOOK_FILES, "a*", &condition);
    EXPECT_EQ(listed(it), Found{"ax"}) << "path, kind, wildcard and condition";
    it = FileIterator((scratch / "other").c_str(), LOOK_FILES, "b*", nullptr);
    EXPECT_EQ(listed(it), Found{"bx"}) << "a wildcard in place of another";
    it = FileIterator((scratch / "other").c_str(), LOOK_FILES, nullptr, nullptr);
    EXPECT_EQ(listed(it), (Found{"ax", "ay", "bx"})) << "none in place of one";
    expectAllClosed();
}
