#include "basis/ground/wildcard.h"

#include "tests/support/random_steps.h"
#include "tests/support/reference_wildcard.h"
#include "tests/support/table.h"

#include "zor_basis/wide_char.h"

#include <gtest/gtest.h>

#include <chrono>
#include <string>
#include <vector>

using ZOR_Basis::AnyCase;
using ZOR_Basis::ExactCase;
using ZOR_Basis::matchesWildcard;

namespace {

std::basic_string<ZOR_Basis::WChar> widened(std::string const& text) { return {text.begin(), text.end()}; }

double milliseconds(std::string const& pattern, std::string const& name, bool expected) {
    auto const begin = std::chrono::steady_clock::now();
    EXPECT_EQ(matchesWildcard(pattern.c_str(), name.c_str()), expected);
    return std::chrono::duration<double, std::milli>(std::chrono::steady_clock::now() - begin).count();
}

std::string repeated(std::string const& text, int times) {
    std::string all;
    for (int i = 0; i < times; ++i) all += text;
    return all;
}

} // namespace

TEST(Wildcard, matches_names_by_their_extension) {
    EXPECT_TRUE(matchesWildcard("*.txt", "note.txt"));
    EXPECT_FALSE(matchesWildcard("*.txt", "note.text"));
}

namespace {

struct Matching {
    Row row;
    char const* pattern;
    char const* name;
    bool expected;
};

Matching const MATCHING[] = {
    {{}, "", "", true},
    {{}, "", "a", false},
    {{}, "a", "", false},
    {{}, "*", "", true},
    {{}, "***", "", true},
    {{}, "?", "", false},
    {{}, "*?", "", false},
    {{}, "a", "a", true},
    {{}, "a", "A", false},
    {{}, "?", "a", true},
    {{}, "?", "/", true},
    {{}, "?", "ab", false},
    {{}, "a?c", "abc", true},
    {{}, "a?c", "a/c", true},
    // the last star takes everything, slashes too
    {{}, "*", "a/b\\c", true},
    {{}, "a*", "a", true},
    {{}, "a*", "a/b", true},
    {{}, "a*", "b", false},
    {{}, "*a", "banana", true},
    {{}, "*an", "banana", false},
    {{}, "b*n*a", "banana", true},
    {{}, "*b", "a/b", true},
    {{}, "*.*", "name", false},
    {{}, "*.*", "name.", true},
    {{}, "*.*", ".", true},
    {{}, "**a**", "xax", true},
    {{}, "*a*b*a", "aba", true},
    {{}, "*a*b*a", "ab", false},
    {{}, "*ab", "b", false},
    {{}, "x*ab", "xb", false},
    {{}, "a*a", "a", false},
    {{}, "ab*bc", "abc", false},
    // the empty end of the name is tried only against stars
    {{}, "a*?", "a", false},
    {{}, "a**", "a", true},
    // runs of slashes of either kind are one
    {{}, "a/b", "a\\b", true},
    {{}, "a//b", "a/b", true},
    {{}, "a/b", "a/\\/b", true},
    {{}, "/", "//", true},
    {{}, "//", "/", true},
    {{}, "a/", "a", false},
    {{}, "a", "a/", false},
    {{}, "?/", "//", true},
    {{}, "?/", "/", false},
    {{}, "/?", "//", false},
    {{}, "*/b", "a//b", true},
    {{}, "*/", "a", false},
    {{}, "*/", "///", true},
    {{}, "*/*/b", "//b", false},
    {{}, "*/*/b", "/a/b", true},
    {{}, "/*/", "//", false},
    // a star that meets a star is an equal character
    {{}, "*", "*", true},
    {{}, "*", "*a", false},
    {{}, "*", "a*", true},
    {{}, "**", "*a", true},
    {{}, "*b", "*ab", false},
    {{}, "**b", "*ab", true},
    {{}, "a*c", "a*c", true},
    {{}, "a*c", "a*bc", false},
    {{}, "*a*", "xa*", true},
    {{}, "*a*", "xa*y", false},
    {{}, "*a*", "xa*yaz", true},
    {{}, "*a*b", "a*xab", true},
};

} // namespace

TEST(Wildcard, follows_the_rule_of_each_character) {
    for (Matching const& c : MATCHING) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(matchesWildcard(c.pattern, c.name), c.expected) << c.pattern << " | " << c.name;
        EXPECT_EQ(literally<ExactCase>(c.pattern, c.name), c.expected) << c.pattern << " | " << c.name;
        EXPECT_EQ(matchesWildcard(widened(c.pattern).c_str(), widened(c.name).c_str()), c.expected);
    }
}

TEST(Wildcard, looks_at_no_more_than_the_characters_given) {
    EXPECT_TRUE(matchesWildcard("a*bXX", 3, "a--bYY", 4));
    EXPECT_FALSE(matchesWildcard("a*bXX", 4, "a--bYY", 4));
    EXPECT_TRUE(matchesWildcard("XX", 0, "YY", 0));
}

TEST(Wildcard, folds_the_case_of_letters_when_asked) {
    struct Case {
        Row row;
        char const* pattern;
        char const* name;
        bool expected;
    };
    for (Case const& c : {
             Case{{}, "*.TXT", "a.txt", true},
             Case{{}, "*.txt", "A.TXT", true},
             Case{{}, "aB*Cd?", "AbxxcDe", true},
             Case{{}, "*b*", "aBc", true},
             Case{{}, "*b*", "ac", false},
             Case{{}, "[", "{", false},
             Case{{}, "@", "`", false},
             Case{{}, "*/X", "a\\x", true},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(matchesWildcard<AnyCase>(c.pattern, c.name), c.expected) << c.pattern << " | " << c.name;
    }
}

TEST(Wildcard, agrees_with_the_literal_recursion_on_every_short_pair) {
    std::string const letters = "a/*?";
    std::vector<std::string> texts{""};
    for (std::size_t from = 0, length = 0; length < 5; ++length) {
        std::size_t const to = texts.size();
        for (; from < to; ++from) {
            for (char letter : letters) texts.push_back(texts[from] + letter);
        }
    }
    for (std::string const& pattern : texts) {
        for (std::string const& name : texts) {
            ASSERT_EQ(matchesWildcard(pattern.c_str(), name.c_str()),
                      literally<ExactCase>(pattern.c_str(), name.c_str()))
                << pattern << " | " << name;
        }
    }
}

TEST(Wildcard, agrees_with_the_literal_recursion_on_random_pairs) {
    std::mt19937_64 random = randomSource();
    auto text = [&](char const* letters, std::size_t count, std::size_t longest) {
        std::string made(random() % (longest + 1), ' ');
        for (char& c : made) c = letters[random() % count];
        return made;
    };
    std::uint64_t matches = 0;
    std::uint64_t const steps = randomSteps(2'000'000);
    for (std::uint64_t i = 0; i < steps; ++i) {
        std::string const pattern = text("ab*/?*B\\*a", 10, 9);
        std::string const name = text("aba/\\*aBa/?", i % 2 == 0 ? 4 : 11, 14);
        bool const exact = literally<ExactCase>(pattern.c_str(), name.c_str());
        ASSERT_EQ(matchesWildcard(pattern.c_str(), name.c_str()), exact) << pattern << " | " << name;
        ASSERT_EQ(matchesWildcard<AnyCase>(pattern.c_str(), name.c_str()),
                  literally<AnyCase>(pattern.c_str(), name.c_str()))
            << pattern << " | " << name;
        if (exact) ++matches;
    }
    // Both answers are frequent, so that the comparison means something.
    EXPECT_GT(matches, steps / 50);
    EXPECT_LT(matches, steps - steps / 50);
}

TEST(Wildcard, is_quick_where_trying_everything_would_never_end) {
    struct Case {
        Row row;
        std::string pattern;
        std::string name;
        bool expected;
    };
    for (Case const& c : {
             Case{{}, "*a*a*a*a*b", std::string(1024, 'a'), false},
             Case{{}, repeated("*a", 40) + "b", std::string(4096, 'a'), false},
             Case{{}, repeated("*a", 40) + "*b*", std::string(4096, 'a'), false},
             Case{{}, repeated("*ab", 40) + "*", repeated("ab", 2048), true},
             Case{{}, repeated("*?", 40) + "/", std::string(4096, 'a'), false},
             Case{{}, repeated("*/", 40) + "b*c*", std::string(4096, '/'), false},
             Case{{}, "*?/b*", std::string(4096, '/'), false},
             Case{{}, repeated("*?/", 20) + "b*", std::string(4096, '/'), false},
             Case{{}, repeated("*\\?", 20) + "*b*", repeated("//a", 1365), false},
             Case{{}, repeated("*", 40) + "b*", std::string(4096, 'a'), false},
             Case{{}, repeated("*a", 40) + "*b*", repeated("a*", 2048), false},
         }) {
        SCOPED_TRACE(c.row);
        // Generous, because the limit also applies under sanitizers on a busy machine.
        EXPECT_LT(milliseconds(c.pattern, c.name, c.expected), 200.0);
    }
}
