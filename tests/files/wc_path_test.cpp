#include <zor_basis/files/wc_path.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(WcPathJoin, Kept_path_07_a_slash_of_either_kind_is_an_end) {
    EXPECT_TRUE(WcPath(ZB_W("dir\\")).add(ZB_W("x")) == ZB_W("dir\\x"));
    EXPECT_TRUE(WcPath(ZB_W("dir/")).add(ZB_W("x")) == ZB_W("dir/x"));
}
