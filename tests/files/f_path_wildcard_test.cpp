#include "tests/files/path_kinds.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis;

namespace {

template <class Kind>
class FPathMatching : public PathOfKind<Kind> {};
TYPED_TEST_SUITE(FPathMatching, PathKinds);

} // namespace

TYPED_TEST(FPathMatching, matches_wildcards) {
    struct Case {
        Row row;
        char const *pattern, *name;
        bool expected;
    };
    for (Case const& c : {
             Case{{}, "*.txt", "a.txt", true},
             Case{{}, "*.txt", "A.TXT", false},
             Case{{}, "*", "anything/at\\all", true},
             Case{{}, "*", "", true},
             Case{{}, "", "", true},
             Case{{}, "", "a", false},
             Case{{}, "a?c", "a/c", true},
             Case{{}, "a//b", "a\\b", true},
             Case{{}, "**", "a", true},
             Case{{}, "a*b*c", "aXbYc", true},
             Case{{}, "a*b", "a", false},
         }) {
        SCOPED_TRACE(c.row);
        auto const pattern = this->t(c.pattern);
        auto const name = this->t(c.name);
        EXPECT_EQ(TypeParam::Path::matchWildCard(pattern.c_str(), name.c_str()), c.expected);
        EXPECT_EQ(this->p(c.name).matchWildCard(pattern.c_str()), c.expected);
    }
    EXPECT_TRUE(TypeParam::Path::matchWildCard(nullptr, nullptr));
}

TEST(FPathWildCard, Kept_path_06_a_star_before_more_pattern_needs_some_name_and_may_be_an_equal_character) {
    EXPECT_FALSE(FPath::matchWildCard("a*?", "a"));
    EXPECT_FALSE(FPath::matchWildCard("*", "*a"));
    EXPECT_TRUE(FPath::matchWildCard("*a", "*a"));
}
