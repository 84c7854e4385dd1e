#include <zor_basis/system/parse.h>

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cctype>
#include <climits>
#include <cstring>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

using namespace ZOR_Basis;
using namespace std::string_literals;

namespace {

constexpr char UNTOUCHED = '\x7F';

/// A scanner over a copy of the text that has nothing behind it, not even a terminator.
class Scanner {
public:
    explicit Scanner(std::string_view text)
        : text_(new char[text.size()]),
          parse_((std::copy(text.begin(), text.end(), text_.get()), text_.get()), static_cast<int>(text.size())) {}
    ZB_Parse* operator->() { return &parse_; }

    struct Line {
        bool whole;
        std::string text;
        bool operator==(Line const&) const = default;
    };

    /// Checks that nothing behind the room is written.
    Line getLine(int maximum) {
        std::string out(static_cast<std::size_t>(maximum) + 3, UNTOUCHED);
        int length = -7;
        bool const whole = parse_.getLine(maximum, out.data(), &length);
        EXPECT_EQ(out[out.size() - 2], UNTOUCHED);
        EXPECT_EQ(static_cast<std::size_t>(length), std::strlen(out.c_str()));
        return {whole, out.c_str()};
    }

private:
    std::unique_ptr<char[]> text_;
    ZB_Parse parse_;
};

using Line = Scanner::Line;

std::ostream& operator<<(std::ostream& out, Line const& line) {
    return out << (line.whole ? "whole <" : "part <") << line.text << '>';
}

} // namespace

TEST(Parse, breathes) {
    Scanner scanner("BEGIN\nname\r\n");
    EXPECT_FALSE(scanner->isDataEnd());
    EXPECT_TRUE(scanner->checkLine("BEGIN"));
    EXPECT_EQ(scanner.getLine(100), (Line{true, "name"}));
    EXPECT_FALSE(scanner->isDataEnd()) << "the line end is left";
    EXPECT_EQ(scanner->skipBlanks(), '\n');
    EXPECT_TRUE(scanner->isDataEnd());
}

TEST(Parse, knows_two_characters_that_end_a_line) {
    for (int c = CHAR_MIN; c <= CHAR_MAX; ++c) {
        EXPECT_EQ(ZB_Parse::isEndOfLine(static_cast<char>(c)), c == 10 || c == 13) << c;
    }
}

TEST(ParseSkipBlanks, gives_the_last_character_that_it_looked_at) {
    struct Case {
        Row row;
        std::string text;
        int first, second;
        bool endsAfterFirst;
    };
    for (Case const& c : {
             Case{{}, "", 0, 0, true},
             Case{{}, "a", 'a', 'a', false},
             Case{{}, " \t\v\f\r\nab", 'a', 'a', false},
             Case{{}, " ", ' ', 0, true},
             Case{{}, "  \t", '\t', 0, true},
             Case{{}, "\n\r", '\r', 0, true},
             Case{{}, "\0a"s, 0, 0, false},
             Case{{}, " \0"s, 0, 0, false},
             Case{{}, "\x7F", 0x7F, 0x7F, false},
             Case{{}, " \xE9", static_cast<char>(0xE9), static_cast<char>(0xE9), false},
             Case{{}, "\x01", 1, 1, false},
         }) {
        SCOPED_TRACE(c.row);
        Scanner scanner(c.text);
        EXPECT_EQ(scanner->skipBlanks(), c.first);
        EXPECT_EQ(scanner->isDataEnd(), c.endsAfterFirst);
        EXPECT_EQ(scanner->skipBlanks(), c.second);
    }
}

TEST(ParseGetLine, reads_lines) {
    struct Case {
        Row row;
        std::string text;
        int maximum;
        std::vector<Line> lines;
    };
    for (Case const& c : {
             Case{{}, "", 10, {{false, ""}, {false, ""}}},
             Case{{}, "a\nb\n", 10, {{true, "a"}, {true, "b"}, {false, ""}}},
             Case{{}, "a\rb\r\nc", 10, {{true, "a"}, {true, "b"}, {false, "c"}, {false, ""}}},
             Case{{}, "\n\n\na\n\n \n\r\n\tb\n", 10, {{true, "a"}, {true, "b"}, {false, ""}}},
             Case{{}, "  a b \t\n", 10, {{true, "a b \t"}}},
             Case{{}, "hello world", 10, {{false, "hello worl"}, {false, "d"}, {false, ""}}},
             Case{{}, "hello worl\n", 10, {{true, "hello worl"}, {false, ""}}},
             Case{{}, "hello worl", 10, {{false, "hello worl"}, {false, ""}}},
             // The rest of a line has its blanks skipped as any line has.
             Case{{}, "hello      world\n", 6, {{false, "hello "}, {true, "world"}}},
             Case{{}, "ab\n", 1, {{false, "a"}, {true, "b"}}},
             Case{{}, "  ab\n", 0, {{false, ""}, {false, ""}}},
             Case{{}, " \n", 10, {{false, ""}}},
         }) {
        SCOPED_TRACE(c.row);
        Scanner scanner(c.text);
        for (Line const& line : c.lines) EXPECT_EQ(scanner.getLine(c.maximum), line);
    }
}

TEST(ParseGetLine, finds_an_end_wherever_it_stands) {
    for (std::size_t before = 1; before < 100; ++before) {
        for (char const end : {'\n', '\r', '\0'}) {
            for (std::size_t behind : {0U, 1U, 40U}) {
                std::string const line(before, 'x');
                Scanner scanner(line + end + std::string(behind, 'y'));
                ASSERT_EQ(scanner.getLine(200), (Line{end != '\0', line}))
                    << before << ' ' << int(end) << ' ' << behind;
            }
        }
    }
}

TEST(ParseGetLine, can_do_without_the_length) {
    Scanner scanner("text\n");
    char out[5];
    EXPECT_TRUE(scanner->getLine(4, out, nullptr));
    EXPECT_STREQ(out, "text");
}

TEST(ParseGetLine, writes_nothing_where_there_is_no_room) {
    Scanner scanner(" text\n");
    int length = 5;
    EXPECT_FALSE(scanner->getLine(-1, nullptr, &length));
    EXPECT_EQ(length, 0);
    EXPECT_FALSE(scanner->getLine(INT_MIN, nullptr, &length));
    EXPECT_EQ(scanner.getLine(10), (Line{true, "text"}));
}

TEST(ParseGetLine, takes_any_maximum) {
    Scanner scanner("text\n");
    char out[16];
    EXPECT_TRUE(scanner->getLine(INT_MAX, out, nullptr)) << "the room is what the line needs";
    EXPECT_STREQ(out, "text");
}

TEST(ParseGetLine, Kept_parse_01_stays_before_a_zero) {
    Scanner scanner("a\nb\0c\nd\n"s);
    EXPECT_EQ(scanner.getLine(10), (Line{true, "a"}));
    for (int i = 0; i < 3; ++i) {
        EXPECT_EQ(scanner.getLine(10), (Line{false, i == 0 ? "b" : ""}));
        EXPECT_FALSE(scanner->isDataEnd());
        EXPECT_EQ(scanner->skipBlanks(), 0);
    }
}

TEST(Parse, has_no_text_below_size_0) {
    for (int const size : {0, -1, INT_MIN}) {
        ZB_Parse parse(nullptr, size);
        EXPECT_TRUE(parse.isDataEnd());
        EXPECT_EQ(parse.skipBlanks(), 0);
        EXPECT_TRUE(parse.checkLine(""));
        char out[2] = "x";
        EXPECT_FALSE(parse.getLine(1, out, nullptr));
        EXPECT_STREQ(out, "");
    }
}

TEST(ParseCheckLine, compares_whole_lines) {
    struct Case {
        Row row;
        std::string text;
        char const* expected;
        bool equal;
    };
    for (Case const& c : {
             Case{{}, "BEGIN\n", "BEGIN", true},
             Case{{}, "BEGIN", "BEGIN", true},
             Case{{}, "\r\n  BEGIN\r\n", "BEGIN", true},
             Case{{}, "BEGINS\n", "BEGIN", false},
             Case{{}, "BEGI\n", "BEGIN", false},
             Case{{}, "begin\n", "BEGIN", false},
             Case{{}, "BEGIN\0more"s, "BEGIN", true},
             Case{{}, "BEGIN\n", "", false},
             Case{{}, "BEGIN\n", nullptr, false},
             Case{{}, "", "", true},
             Case{{}, "  \n", "", true},
             Case{{}, "", nullptr, true},
             Case{{}, "", "x", false},
         }) {
        SCOPED_TRACE(c.row);
        Scanner scanner(c.text);
        EXPECT_EQ(scanner->checkLine(c.expected), c.equal);
    }
}

TEST(ParseCheckLine, Kept_parse_02_has_blanks_at_the_end_count) {
    EXPECT_FALSE(Scanner("  BEGIN \r\n")->checkLine("BEGIN"));
    EXPECT_TRUE(Scanner("  BEGIN \r\n")->checkLine("BEGIN "));
}

TEST(ParseCheckLine, takes_the_line_whatever_comes_out) {
    Scanner scanner("one\ntwo\nthree\n");
    EXPECT_FALSE(scanner->checkLine("two"));
    EXPECT_TRUE(scanner->checkLine("two"));
    EXPECT_FALSE(scanner->checkLine("two"));
    EXPECT_EQ(scanner.getLine(10), (Line{false, ""}));
}

TEST(ParseCheckLine, looks_at_256_bytes_of_a_line) {
    for (std::size_t size : {255U, 256U, 257U, 600U}) {
        SCOPED_TRACE(size);
        std::string const text(size, 'x');
        std::string const read = text.substr(0, 256);
        Scanner scanner(text + "\n");
        EXPECT_TRUE(scanner->checkLine(read.c_str()));
        EXPECT_EQ(scanner.getLine(1000), (size > 256 ? Line{true, text.substr(256)} : Line{false, ""}));
        EXPECT_EQ(Scanner(text + "\n")->checkLine(text.c_str()), size <= 256);
    }
}

namespace {

/// The rules of the scanner, a character at a time.
class Model {
public:
    explicit Model(std::string const& text) : text_(text) {}

    bool isEnd() const { return at_ >= text_.size(); }
    int skipBlanks() {
        char last = 0;
        for (; !isEnd(); ++at_) {
            last = text_[at_];
            if (std::isspace(static_cast<unsigned char>(last)) == 0) break;
        }
        return last;
    }
    Line getLine(std::size_t maximum) {
        skipBlanks();
        Line line{false, ""};
        while (!isEnd() && line.text.size() < maximum && text_[at_] != 0 && text_[at_] != 10 && text_[at_] != 13)
            line.text += text_[at_++];
        line.whole = !isEnd() && (text_[at_] == 10 || text_[at_] == 13);
        return line;
    }

private:
    std::string text_;
    std::size_t at_ = 0;
};

} // namespace

TEST(ParseModel, agrees_with_reading_a_character_at_a_time) {
    auto random = randomSource();
    auto const below = [&random](std::uint64_t bound) { return random() % bound; };
    std::string const alphabet = "abcdefghijklmnopqrstuvwxyz  \n\n\r\t\x85\xA0";
    for (std::uint64_t round = randomSteps(2000); round > 0; --round) {
        std::string text;
        for (std::uint64_t i = below(300); i > 0; --i) {
            text += below(400) == 0 ? '\0' : alphabet[below(below(2) == 0 ? 26 : alphabet.size())];
        }
        Scanner scanner(text);
        Model model(text);
        for (int step = 0; step < 30; ++step) {
            ASSERT_EQ(scanner->isDataEnd(), model.isEnd());
            switch (below(3)) {
            case 0:
                ASSERT_EQ(scanner->skipBlanks(), model.skipBlanks());
                break;
            case 1: {
                std::size_t const maximum = below(below(2) == 0 ? 5 : 100);
                ASSERT_EQ(scanner.getLine(static_cast<int>(maximum)), model.getLine(maximum));
                break;
            }
            default: {
                Model ahead = model;
                std::string const line = model.getLine(256).text;
                ASSERT_TRUE(ahead.getLine(256).text == line);
                ASSERT_TRUE(scanner->checkLine(line.c_str()));
            }
            }
        }
    }
}
