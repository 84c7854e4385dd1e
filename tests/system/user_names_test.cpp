// Qualified user names and names of domains, and what holds of users on every machine.

#include <zor_basis/system.h>

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <memory>
#include <type_traits>

using namespace ZOR_Basis;

TEST(ParseUser, takes_qualified_names_apart) {
    struct Case {
        Row row;
        char const *full, *user, *domain;
        bool result;
    };
    for (Case const& c : {
             Case{{}, "jdoe@SALES", "jdoe", "SALES", true},
             Case{{}, "SALES\\jdoe", "jdoe", "SALES", true},
             Case{{}, "SALES/jdoe", "jdoe", "SALES", true},
             Case{{}, "jdoe", "jdoe", "before", false},
             Case{{}, "a@b@c", "a", "b@c", true},
             Case{{}, "a\\b\\c", "b\\c", "a", true},
             Case{{}, "a/b/c", "b/c", "a", true},
             Case{{}, "a/b\\c", "c", "a/b", true},
             Case{{}, "a\\b/c", "b/c", "a", true},
             Case{{}, "DOM\\jane@example.com", "DOM\\jane", "example.com", true},
             Case{{}, "DOM/jane@example.com", "DOM/jane", "example.com", true},
             Case{{}, "@", "", "", true},
             Case{{}, "@SALES", "", "SALES", true},
             Case{{}, "jdoe@", "jdoe", "", true},
             Case{{}, "\\", "", "", true},
             Case{{}, "\\jdoe", "jdoe", "", true},
             Case{{}, "SALES\\", "", "SALES", true},
             Case{{}, "/jdoe", "jdoe", "", true},
             Case{{}, "SALES/", "", "SALES", true},
             Case{{}, " ", " ", "before", false},
             Case{{},
                  "a user of more than 15 bytes@a domain of more than 15 bytes",
                  "a user of more than 15 bytes",
                  "a domain of more than 15 bytes",
                  true},
         }) {
        SCOPED_TRACE(c.row);
        BufStr<15> user("someone"), domain("before");
        EXPECT_EQ(Sys::ParseUser(c.full, user, domain), c.result);
        EXPECT_STREQ(user.c_str(), c.user);
        EXPECT_STREQ(domain.c_str(), c.domain);
        EXPECT_EQ(user.size(), std::string(c.user).size());
        EXPECT_EQ(domain.size(), std::string(c.domain).size());
    }
}

TEST(ParseUser, takes_views_of_parts) {
    BufStr<15> user, domain;
    EXPECT_TRUE(Sys::ParseUser(Str("jdoe@SALES and more", 10), user, domain));
    EXPECT_STREQ(user.c_str(), "jdoe");
    EXPECT_STREQ(domain.c_str(), "SALES");
    EXPECT_FALSE(Sys::ParseUser(Str("jdoe@SALES", 4), user, domain));
    EXPECT_STREQ(user.c_str(), "jdoe");
}

TEST(ParseUser, Kept_sys_03_leaves_the_domain_where_there_is_none) {
    BufStr<15> user, domain("SALES");
    EXPECT_FALSE(Sys::ParseUser("jdoe", user, domain));
    EXPECT_STREQ(user.c_str(), "jdoe");
    EXPECT_STREQ(domain.c_str(), "SALES");
}

TEST(ParseUser, knows_the_current_user_and_domain) {
    BufStr<15> user("x"), domain("y"), currentUser, currentDomain;
    bool const known = Sys::CurrentUser(currentUser, false);
    Sys::CurrentDomain(currentDomain, false);
    EXPECT_EQ(Sys::ParseUser("", user, domain), known);
    EXPECT_STREQ(user.c_str(), currentUser.c_str());
    EXPECT_STREQ(domain.c_str(), currentDomain.c_str());
}

TEST(isCompositeName, looks_for_a_full_stop) {
    EXPECT_TRUE(Sys::isCompositeName("sales.example.com"));
    EXPECT_TRUE(Sys::isCompositeName("."));
    EXPECT_TRUE(Sys::isCompositeName("sales."));
    EXPECT_FALSE(Sys::isCompositeName("SALES"));
    EXPECT_FALSE(Sys::isCompositeName(""));
    EXPECT_FALSE(Sys::isCompositeName(Str("sales.example", 5)));
    EXPECT_TRUE(Sys::isCompositeName(Str("sales.example", 6)));
}

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

TEST(SysHdl, is_nobody_by_itself) {
    static_assert(std::has_virtual_destructor_v<SysHdl>);
    std::unique_ptr<SysHdl> const handle(new SysHdl);
    EXPECT_FALSE(handle->isValid());
    EXPECT_FALSE(Sys::impersonate(handle.get())) << "nobody to act as";
    EXPECT_TRUE(Sys::revertToSelf());
}

TEST(SysDrives, do_not_know_paths_that_are_none) {
    FPath unc("before");
    EXPECT_FALSE(Sys::isLocalDisk(""));
    EXPECT_FALSE(Sys::UnMap("", unc));
    EXPECT_FALSE(Sys::UnMap("", "nobody we know", unc));
    EXPECT_FALSE(Sys::UnMapLogin("", unc));
    EXPECT_STREQ(unc.c_str(), "before");
}
