#include <zor_basis/walk.h>

#include "tests/walk/visited_tree.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileMoveVisitorOnDisk : VisitedTree {};

} // namespace

TEST_F(FileMoveVisitorOnDisk, leaves_nothing_behind) {
    FileMoveVisitor move(at("dst"), false);
    EXPECT_TRUE(walk("src", move));
    EXPECT_EQ(scratch.content("src"), Names{});
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
}

TEST_F(FileMoveVisitorOnDisk, fails_on_what_is_there_unless_it_may_overwrite) {
    put(scratch / "dst/a", "old");
    FileEntry file = entry("src", "a");
    EXPECT_FALSE(FileMoveVisitor(at("dst"), false).perform(&file));
    EXPECT_EQ(textOf(scratch / "dst/a"), "old");
    EXPECT_TRUE(exists(scratch / "src/a"));
    EXPECT_TRUE(FileMoveVisitor(at("dst"), true).perform(&file));
    EXPECT_EQ(textOf(scratch / "dst/a"), "aa");
    EXPECT_FALSE(exists(scratch / "src/a"));
}

TEST_F(FileMoveVisitorOnDisk, copies_where_the_platform_cannot_move) {
    ASSERT_EQ(xos_HostFail("xos_FileMove", 0, 1), 0);
    ASSERT_EQ(xos_HostFail("xos_DirMove", 0, 1), 0);
    FileMoveVisitor move(at("dst"), false);
    EXPECT_TRUE(walk("src", move));
    EXPECT_EQ(scratch.content("src"), Names{});
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    EXPECT_EQ(textOf(scratch / "dst/d/e/c"), "cccc");
}

TEST_F(FileMoveVisitorOnDisk, loses_the_source_where_the_copy_fails_too) {
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
