// What holds of users on every machine.

#include <zor_basis/system.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(SysUsers, know_the_user_of_the_thread) {
    BufStr<15> user("before");
    EXPECT_TRUE(Sys::CurrentUser(user, false));
    EXPECT_FALSE(user.empty());
    BufStr<15> again;
    EXPECT_TRUE(Sys::CurrentUser(again, false));
    EXPECT_STREQ(again.c_str(), user.c_str());
}

TEST(SysUsers, clear_what_was_there) {
    BufStr<15> text("before");
    Sys::CurrentUser(text, true);
    EXPECT_STRNE(text.c_str(), "before");
    text = "before";
    Sys::CurrentDomain(text, false);
    EXPECT_STRNE(text.c_str(), "before");
    text = "before";
    EXPECT_TRUE(Sys::CurrentDomain(text, true));
    EXPECT_STRNE(text.c_str(), "before");
    text = "before";
    Sys::DefaultLogin(text);
    EXPECT_STRNE(text.c_str(), "before");
    text = "before";
    Sys::CurHumanUser(text);
    EXPECT_STRNE(text.c_str(), "before");
}

TEST(SysUsers, know_no_domain_that_nobody_has_named) {
    BufStr<255> domain("before");
    EXPECT_FALSE(Sys::FullDomain("no such domain", domain));
    EXPECT_FALSE(Sys::ShortDomain("no.such.domain", domain));
    EXPECT_STREQ(domain.c_str(), "before");
}
