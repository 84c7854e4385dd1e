#include <zor_basis/walk.h>

#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <initializer_list>

using namespace ZOR_Basis;

namespace {

struct VisitorsTest : testing::Test {
    VisitorsTest() {
        makeFolder(scratch / "src/d/e");
        makeFolder(scratch / "dst");
        put(scratch / "src/a", "aa");
        put(scratch / "src/d/b", "bbb");
        put(scratch / "src/d/e/c", "cccc");
    }
    ~VisitorsTest() override { xos_HostFailClear(); }

    FPath at(char const* name) const { return {(scratch / name).c_str()}; }
    bool walk(char const* from, FileVisitor& visitor, LookForType type = LOOK_BOTH, bool stopOnFalse = true) const {
        return FileIterator(at(from), type, nullptr, nullptr).doIt(&visitor, false, stopOnFalse);
    }
    FileEntry entry(char const* dir, char const* name) const { return {at(dir), name, 0}; }

    Scratch scratch;
};

} // namespace

TEST_F(VisitorsTest, copying_takes_trees_with_it) {
    FileCopyVisitor copy(at("dst"), false, true);
    EXPECT_TRUE(walk("src", copy));
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    EXPECT_EQ(scratch.content("src"), scratch.content("dst"));
}

TEST_F(VisitorsTest, copying_without_recursion_takes_the_files_of_directories) {
    FileCopyVisitor copy(at("dst"), false, false);
    EXPECT_TRUE(walk("src", copy));
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b"}));
}

TEST_F(VisitorsTest, copying_fails_on_what_is_there_unless_it_may_overwrite) {
    makeFolder(scratch / "dst/a/x");
    put(scratch / "dst/d", "old");
    FileCopyVisitor keep(at("dst"), false, true);
    FileEntry file = entry("src", "a");
    FileEntry folder = entry("src", "d");
    EXPECT_FALSE(keep.perform(&file));
    EXPECT_FALSE(keep.perform(&folder));
    EXPECT_FALSE(walk("src", keep));
    EXPECT_EQ(scratch.content("dst"), (Names{"a/", "a/x/", "d"}));
    FileCopyVisitor replace(at("dst"), true, true);
    EXPECT_TRUE(walk("src", replace));
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    EXPECT_EQ(textOf(scratch / "dst/a"), "aa");
}

TEST_F(VisitorsTest, leave_what_is_in_the_target_already_alone) {
    makeFolder(scratch / "src/d/t");
    put(scratch / "src/d/t/own", "own");
    FileCopyVisitor copy(at("src/d/t"), false, false);
    FileMoveVisitor move(at("src/d/t"), false);
    FileEntry own = entry("src/d/t", "own");
    EXPECT_TRUE(copy.perform(&own));
    EXPECT_TRUE(move.perform(&own));
    EXPECT_EQ(textOf(scratch / "src/d/t/own"), "own");
    FileCopyVisitor files(at("src/d/t"), true, false);
    EXPECT_TRUE(FileIterator(at("src"), LOOK_FILES, nullptr, nullptr).doIt(&files, true, true));
    EXPECT_EQ(scratch.content("src/d/t"), (Names{"a", "b", "c", "own"}));
}

TEST_F(VisitorsTest, moving_leaves_nothing_behind) {
    FileMoveVisitor move(at("dst"), false);
    EXPECT_TRUE(walk("src", move));
    EXPECT_EQ(scratch.content("src"), Names{});
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
}

TEST_F(VisitorsTest, moving_fails_on_what_is_there_unless_it_may_overwrite) {
    put(scratch / "dst/a", "old");
    FileEntry file = entry("src", "a");
    EXPECT_FALSE(FileMoveVisitor(at("dst"), false).perform(&file));
    EXPECT_EQ(textOf(scratch / "dst/a"), "old");
    EXPECT_TRUE(exists(scratch / "src/a"));
    EXPECT_TRUE(FileMoveVisitor(at("dst"), true).perform(&file));
    EXPECT_EQ(textOf(scratch / "dst/a"), "aa");
    EXPECT_FALSE(exists(scratch / "src/a"));
}

TEST_F(VisitorsTest, tell_of_every_failing_call) {
    struct Case {
        Row row;
        char const* function;
        char const* name;
        bool move;
        bool there;
    };
    for (Case const& c : {
             Case{{}, "xos_FileCopy", "a", false, false},
             Case{{}, "xos_DirCopy", "d", false, false},
             Case{{}, "xos_FileRemove", "a", false, true},
             Case{{}, "xos_FileRemove", "a", true, true},
         }) {
        SCOPED_TRACE(c.row);
        put(scratch / "dst/a", "old");
        if (!c.there) std::filesystem::remove(scratch / "dst/a");
        FileEntry one = entry("src", c.name);
        ASSERT_EQ(xos_HostFail(c.function, 0, 1), 0);
        FileCopyVisitor copy(at("dst"), true, true);
        FileMoveVisitor move(at("dst"), true);
        EXPECT_FALSE(c.move ? move.perform(&one) : copy.perform(&one));
        xos_HostFailClear();
        EXPECT_EQ(exists(scratch / "dst/a"), c.there);
        EXPECT_TRUE(exists(scratch / "src/a"));
    }
}

TEST_F(VisitorsTest, moving_copies_where_the_platform_cannot_move) {
    ASSERT_EQ(xos_HostFail("xos_FileMove", 0, 1), 0);
    ASSERT_EQ(xos_HostFail("xos_DirMove", 0, 1), 0);
    FileMoveVisitor move(at("dst"), false);
    EXPECT_TRUE(walk("src", move));
    EXPECT_EQ(scratch.content("src"), Names{});
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    EXPECT_EQ(textOf(scratch / "dst/d/e/c"), "cccc");
}

TEST_F(VisitorsTest, moving_loses_the_source_where_the_copy_fails_too) {
    FileMoveVisitor move(at("dst"), false);
    FileEntry file = entry("src", "a");
    ASSERT_EQ(xos_HostFail("xos_FileMove", 0, 1), 0);
    ASSERT_EQ(xos_HostFail("xos_FileCopy", 0, 1), 0);
    EXPECT_FALSE(move.perform(&file));
    FileEntry folder = entry("src", "d");
    ASSERT_EQ(xos_HostFail("xos_DirMove", 0, 1), 0);
    ASSERT_EQ(xos_HostFail("xos_DirCopy", 0, 1), 0);
    EXPECT_FALSE(move.perform(&folder));
    EXPECT_EQ(scratch.content("src"), Names{});
    EXPECT_EQ(scratch.content("dst"), Names{});
}

TEST_F(VisitorsTest, keep_a_directory_that_cannot_be_removed) {
    makeFolder(scratch / "dst/d/old");
    FileEntry folder = entry("src", "d");
    FileCopyVisitor copy(at("dst"), true, true);
    FileMoveVisitor move(at("dst"), true);
    FileDeleteVisitor remove;
    for (FileVisitor* visitor : std::initializer_list<FileVisitor*>{&copy, &move, &remove}) {
        ASSERT_EQ(xos_HostFail("xos_DirRemove", 0, 1), 0);
        EXPECT_FALSE(visitor->perform(&folder));
        EXPECT_EQ(scratch.content("dst"), (Names{"d/", "d/old/"}));
        EXPECT_EQ(scratch.content("src"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    }
}

TEST_F(VisitorsTest, fail_an_entry_and_go_on_with_the_others) {
    put(scratch / "dst/a", "old");
    FileCopyVisitor copy(at("dst"), false, true);
    walk("src", copy, LOOK_BOTH, false);
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    EXPECT_EQ(textOf(scratch / "dst/a"), "old");
}

TEST_F(VisitorsTest, deleting_removes_files_and_trees) {
    FileDeleteVisitor remove;
    EXPECT_TRUE(walk("src", remove));
    EXPECT_EQ(scratch.content(), (Names{"src/", "dst/"}));
    FileEntry gone = entry("src", "a");
    EXPECT_TRUE(remove.perform(&gone));
}

TEST_F(VisitorsTest, freeing_a_path_removes_only_when_asked) {
    EXPECT_TRUE(zbCheckRemoveFileDir(at("none"), false));
    EXPECT_TRUE(zbCheckRemoveFileDir(at("none"), true));
    for (char const* name : {"src/a", "src/d"}) {
        EXPECT_FALSE(zbCheckRemoveFileDir(at(name), false));
        EXPECT_TRUE(exists(scratch / name));
        ASSERT_EQ(xos_HostFail(name[4] == 'a' ? "xos_FileRemove" : "xos_DirRemove", 0, 1), 0);
        EXPECT_FALSE(zbCheckRemoveFileDir(at(name), true));
        xos_HostFailClear();
        EXPECT_TRUE(zbCheckRemoveFileDir(at(name), true));
        EXPECT_FALSE(exists(scratch / name));
    }
}

TEST_F(VisitorsTest, counting_ends_at_its_limit) {
    for (int i = 0; i < 10; ++i) put(scratch / ("dst/" + std::to_string(i)), "");
    makeFolder(scratch / "dst/d");
    EXPECT_EQ(FileCountVisitor::Get(at("dst"), LOOK_FILES, 3), 3);
    EXPECT_EQ(FileCountVisitor::Get(at("dst"), LOOK_FILES, 0), 10);
    EXPECT_EQ(FileCountVisitor::Get(at("dst"), LOOK_BOTH, 100), 11);
    EXPECT_EQ(FileCountVisitor::Get(at("dst"), LOOK_ALL, 0), 1);
    EXPECT_EQ(FileCountVisitor::Get(at("none"), LOOK_BOTH, 3), 0);
    EXPECT_EQ(FileCountVisitor::Get(at("src"), LOOK_FILES, 0), 1) << "one level only";
}

TEST_F(VisitorsTest, Kept_walk_08_compares_the_low_32_bits_of_the_limit_with_a_sign) {
    for (std::uint64_t const limit : {0x80000000u * std::uint64_t{1}, std::uint64_t{1} << 32}) {
        EXPECT_TRUE(FileCountVisitor(limit).stop()) << limit;
        EXPECT_EQ(FileCountVisitor::Get(at("src"), LOOK_BOTH, limit), 0) << limit;
    }
    EXPECT_FALSE(FileCountVisitor(0x7FFFFFFF).stop());
    EXPECT_FALSE(FileCountVisitor(0).stop());
    EXPECT_EQ(FileCountVisitor::Get(at("src"), LOOK_BOTH, (std::uint64_t{1} << 32) + 1), 1);
}

TEST_F(VisitorsTest, sizes_are_summed) {
    EXPECT_EQ(FileSizeVisitor::Get(at("src/a"), false), 2);
    EXPECT_EQ(FileSizeVisitor::Get(at("none"), true), 0);
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), false), 2) << "the files of the top level";
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), true), 9);
    EXPECT_EQ(FileSizeVisitor::Get(at("src/d"), false), 3);
    FileSizeVisitor flat(false);
    EXPECT_TRUE(walk("src", flat));
    EXPECT_EQ(flat.total(), 2 + 3);
    FileSizeVisitor whole(true);
    EXPECT_TRUE(walk("src", whole));
    EXPECT_EQ(whole.total(), 9);
}

TEST_F(VisitorsTest, Kept_walk_10_linking_takes_the_source_first_and_what_is_there_as_it_is) {
    std::string const src = scratch / "src/a";
    std::string const dst = scratch / "dst/x";
    EXPECT_TRUE(zbLinkOrCopy(src.c_str(), dst.c_str(), false));
    put(dst, "via");
    EXPECT_EQ(textOf(src), "via") << "one file of two names";
    put(scratch / "src/other", "other");
    EXPECT_TRUE(zbLinkOrCopy((scratch / "src/other").c_str(), dst.c_str(), false));
    EXPECT_EQ(textOf(dst), "via");
    EXPECT_TRUE(zbLinkOrCopy((scratch / "src/other").c_str(), dst.c_str(), true));
    EXPECT_EQ(textOf(dst), "other");
    EXPECT_EQ(textOf(src), "via");
}

TEST_F(VisitorsTest, linking_copies_where_there_are_no_links) {
    std::string const src = scratch / "src/a";
    std::string const dst = scratch / "dst/x";
    ASSERT_EQ(xos_HostFail("xos_FileHardLink", 0, 1), 0);
    EXPECT_TRUE(zbLinkOrCopy(src.c_str(), dst.c_str(), true));
    EXPECT_EQ(textOf(dst), "aa");
    put(dst, "own");
    EXPECT_EQ(textOf(src), "aa");
    ASSERT_EQ(xos_HostFail("xos_FileHardLink", 0, 1), 0);
    ASSERT_EQ(xos_HostFail("xos_FileCopy", 0, 1), 0);
    EXPECT_FALSE(zbLinkOrCopy(src.c_str(), (scratch / "dst/y").c_str(), true));
}
