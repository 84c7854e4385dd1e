#include <zor_basis/system.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(SysLogon, needs_a_user) {
    EXPECT_EQ(Sys::loginUser("", "secret", true), nullptr);
    EXPECT_EQ(Sys::loginUser("", "", false), nullptr);
}

TEST(SysLogon, lets_a_thread_that_is_itself_be_itself) {
    BufStr<15> before, after;
    Sys::CurrentUser(before, false);
    EXPECT_TRUE(Sys::impersonate(nullptr));
    EXPECT_TRUE(Sys::revertToSelf());
    EXPECT_TRUE(Sys::revertToSelf());
    EXPECT_TRUE(Sys::impersonate(nullptr));
    Sys::CurrentUser(after, false);
    EXPECT_STREQ(after.c_str(), before.c_str());
}
