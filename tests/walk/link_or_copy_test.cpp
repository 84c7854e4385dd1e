#include <zor_basis/walk.h>

#include "tests/walk/visited_tree.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct LinkOrCopyOnDisk : VisitedTree {};

} // namespace

TEST_F(LinkOrCopyOnDisk, Kept_walk_10_linking_takes_the_source_first_and_what_is_there_as_it_is) {
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

TEST_F(LinkOrCopyOnDisk, copies_where_there_are_no_links) {
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
