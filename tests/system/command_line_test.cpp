#include "basis/system/command_line.h"

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

using Words = std::vector<std::string>;

Words wordsOf(std::string const& text) {
    CommandLine const line(text.c_str());
    Words words;
    for (char* const* word = line.words(); *word != nullptr; ++word) words.emplace_back(*word);
    EXPECT_EQ(words.size(), line.size());
    return words;
}

} // namespace

TEST(CommandLine, is_split) {
    struct Case {
        Row row;
        char const* text;
        Words words;
    };
    for (Case const& c : {
             Case{{}, "", {""}},
             Case{{}, "a", {"a"}},
             Case{{}, "a b", {"a", "b"}},
             Case{{}, "a \t b\t", {"a", "b"}},
             Case{{}, " a", {"", "a"}},
             Case{{}, " a b", {"", "a", "b"}},
             Case{{}, "a\nb c", {"a\nb", "c"}},
             // The program: no escapes.
             Case{{}, "\"C:\\a b\\c.exe\" d", {"C:\\a b\\c.exe", "d"}},
             Case{{}, "a\" \"b c", {"a b", "c"}},
             Case{{}, "\"a\\\" b", {"a\\", "b"}},
             Case{{}, "\"a\"\"b\" c", {"ab", "c"}},
             Case{{}, "\"a b", {"a b"}},
             Case{{}, "\"\" a", {"", "a"}},
             // The others: quoted parts.
             Case{{}, "p \"a b\"", {"p", "a b"}},
             Case{{}, "p a\" \"b", {"p", "a b"}},
             Case{{}, "p \"\"", {"p", ""}},
             Case{{}, "p \"\" \"\"", {"p", "", ""}},
             Case{{}, "p \"a b", {"p", "a b"}},
             Case{{}, "p \"", {"p", ""}},
             Case{{}, "p a\"\"b c", {"p", "ab", "c"}},
             // Two double quotes inside a quoted part.
             Case{{}, "p \"ab\"\"cd\" e", {"p", "ab\"cd", "e"}},
             Case{{}, "p \"\"\"\" e", {"p", "\"", "e"}},
             Case{{}, "p \"\"\" e", {"p", "\" e"}},
             Case{{}, "p \"a\"\"\" e", {"p", "a\"", "e"}},
             // Backslashes.
             Case{{}, "p a\\b\\\\c", {"p", "a\\b\\\\c"}},
             Case{{}, "p \\", {"p", "\\"}},
             Case{{}, "p \\\\ b", {"p", "\\\\", "b"}},
             Case{{}, "p \\\"", {"p", "\""}},
             Case{{}, "p \\\"a b", {"p", "\"a", "b"}},
             Case{{}, "p \\\\\"a b\"", {"p", "\\a b"}},
             Case{{}, "p \\\\\\\"a b", {"p", "\\\"a", "b"}},
             Case{{}, "p \"a\\\\\" b", {"p", "a\\", "b"}},
             Case{{}, "p \"a\\\" b", {"p", "a\" b"}},
             Case{{}, "p \"a\\b c\\\" d", {"p", "a\\b c\" d"}},
             Case{{}, "p \"\\\\\"\" c", {"p", "\\\" c"}},
             Case{{}, "p a\\\tb", {"p", "a\\", "b"}},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(wordsOf(c.text), c.words);
    }
}

TEST(CommandLine, gives_back_words_that_were_quoted) {
    auto random = randomSource();
    std::string const alphabet = "ab \t\"\\\"\\";
    for (std::uint64_t round = randomSteps(3000); round > 0; --round) {
        Words words{"program"};
        std::string text = "program";
        for (std::uint64_t count = random() % 5; count > 0; --count) {
            std::string word;
            for (std::uint64_t i = random() % 8; i > 0; --i) word += alphabet[random() % alphabet.size()];
            words.push_back(word);
            text += " \"";
            std::size_t backslashes = 0;
            for (char const c : word) {
                if (c == '"') text.append(backslashes + 1, '\\');
                backslashes = c == '\\' ? backslashes + 1 : 0;
                text += c;
            }
            text.append(backslashes, '\\');
            text += '"';
        }
        ASSERT_EQ(wordsOf(text), words) << text;
    }
}
