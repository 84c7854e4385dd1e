#include <zor_basis/system.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(SysDrives, do_not_know_paths_that_are_none) {
    FPath unc("before");
    EXPECT_FALSE(Sys::isLocalDisk(""));
    EXPECT_FALSE(Sys::UnMap("", unc));
    EXPECT_FALSE(Sys::UnMap("", "nobody we know", unc));
    EXPECT_FALSE(Sys::UnMapLogin("", unc));
    EXPECT_STREQ(unc.c_str(), "before");
}
