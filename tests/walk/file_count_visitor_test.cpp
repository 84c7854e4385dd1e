#include <zor_basis/walk.h>

#include "tests/walk/visited_tree.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileCountVisitorOnDisk : VisitedTree {};

} // namespace

TEST_F(FileCountVisitorOnDisk, ends_at_its_limit) {
    for (int i = 0; i < 10; ++i) put(scratch / ("dst/" + std::to_string(i)), "");
    makeFolder(scratch / "dst/d");
    EXPECT_EQ(FileCountVisitor::Get(at("dst"), LOOK_FILES, 3), 3);
    EXPECT_EQ(FileCountVisitor::Get(at("dst"), LOOK_FILES, 0), 10);
    EXPECT_EQ(FileCountVisitor::Get(at("dst"), LOOK_BOTH, 100), 11);
    EXPECT_EQ(FileCountVisitor::Get(at("dst"), LOOK_ALL, 0), 1);
    EXPECT_EQ(FileCountVisitor::Get(at("none"), LOOK_BOTH, 3), 0);
    EXPECT_EQ(FileCountVisitor::Get(at("src"), LOOK_FILES, 0), 1) << "one level only";
}

TEST_F(FileCountVisitorOnDisk, counts_nothing_where_nothing_can_be_listed) {
    EXPECT_EQ(FileCountVisitor::Get(at("src/a"), LOOK_BOTH, 3), 0) << "a file";
    for (char const* call : {"xos_DirOpenEx", "xos_DirNextEx"}) {
        ASSERT_EQ(xos_HostFail(call, 0, 1), 0);
        EXPECT_EQ(FileCountVisitor::Get(at("src"), LOOK_BOTH, 0), 0) << call;
        xos_HostFailClear();
    }
    EXPECT_EQ(FileCountVisitor::Get(at("src"), LOOK_BOTH, 0), 2);
}

TEST_F(FileCountVisitorOnDisk, Kept_walk_08_compares_the_low_32_bits_of_the_limit_with_a_sign) {
    for (std::uint64_t const limit : {0x80000000u * std::uint64_t{1}, std::uint64_t{1} << 32}) {
        EXPECT_TRUE(FileCountVisitor(limit).stop()) << limit;
        EXPECT_EQ(FileCountVisitor::Get(at("src"), LOOK_BOTH, limit), 0) << limit;
    }
    EXPECT_FALSE(FileCountVisitor(0x7FFFFFFF).stop());
    EXPECT_FALSE(FileCountVisitor(0).stop());
    EXPECT_EQ(FileCountVisitor::Get(at("src"), LOOK_BOTH, (std::uint64_t{1} << 32) + 1), 1);
}
