#include <zor_basis/walk.h>

#include "tests/walk/visited_tree.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileDeleteVisitorOnDisk : VisitedTree {};

} // namespace

TEST_F(FileDeleteVisitorOnDisk, removes_files_and_trees) {
    FileDeleteVisitor remove;
    EXPECT_TRUE(walk("src", remove));
    EXPECT_EQ(scratch.content(), (Names{"src/", "dst/"}));
    FileEntry gone = entry("src", "a");
    EXPECT_TRUE(remove.perform(&gone));
}

TEST_F(FileDeleteVisitorOnDisk, freeing_a_path_removes_only_when_asked) {
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
