#include <zor_basis/walk.h>

#include "tests/walk/visited_tree.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileSizeVisitorOnDisk : VisitedTree {};

} // namespace

TEST_F(FileSizeVisitorOnDisk, sums_sizes) {
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
