#include <zor_basis/walk.h>

#include "tests/walk/visited_tree.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileCopyVisitorOnDisk : VisitedTree {};

} // namespace

TEST_F(FileCopyVisitorOnDisk, takes_trees_with_it) {
    FileCopyVisitor copy(at("dst"), false, true);
    EXPECT_TRUE(walk("src", copy));
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    EXPECT_EQ(scratch.content("src"), scratch.content("dst"));
}

TEST_F(FileCopyVisitorOnDisk, without_recursion_takes_the_files_of_directories) {
    FileCopyVisitor copy(at("dst"), false, false);
    EXPECT_TRUE(walk("src", copy));
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b"}));
}

TEST_F(FileCopyVisitorOnDisk, fails_on_what_is_there_unless_it_may_overwrite) {
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

TEST_F(FileCopyVisitorOnDisk, fails_an_entry_and_goes_on_with_the_others) {
    put(scratch / "dst/a", "old");
    FileCopyVisitor copy(at("dst"), false, true);
    walk("src", copy, LOOK_BOTH, false);
    EXPECT_EQ(scratch.content("dst"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    EXPECT_EQ(textOf(scratch / "dst/a"), "old");
}
