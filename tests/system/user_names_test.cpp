// Qualified user names and names of domains.

#include <zor_basis/system.h>

#include "tests/support/table.h"

#include <gtest/gtest.h>

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

TEST(IsCompositeName, looks_for_a_full_stop) {
    EXPECT_TRUE(Sys::isCompositeName("sales.example.com"));
    EXPECT_TRUE(Sys::isCompositeName("."));
    EXPECT_TRUE(Sys::isCompositeName("sales."));
    EXPECT_FALSE(Sys::isCompositeName("SALES"));
    EXPECT_FALSE(Sys::isCompositeName(""));
    EXPECT_FALSE(Sys::isCompositeName(Str("sales.example", 5)));
    EXPECT_TRUE(Sys::isCompositeName(Str("sales.example", 6)));
}
