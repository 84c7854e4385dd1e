#include "zor_basis/text/str.h"

#include "tests/support/table.h"
#include "tests/text/naive_order.h"
#include "tests/text/string_kinds.h"
#include "zor_basis/text/buf_str.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <sstream>
#include <string>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

static_assert(std::is_trivially_copyable_v<Str> && !std::is_polymorphic_v<Str>);
static_assert(std::is_convertible_v<char const*, Str> && std::is_convertible_v<std::string, Str>);
static_assert(std::is_convertible_v<Str, char const*> && !std::is_convertible_v<Str, std::string_view>);
static_assert(std::is_constructible_v<std::string_view, Str>);

TEST(Str, breathes) {
    Str const view("job.ps");
    EXPECT_EQ(view.size(), 6U);
    EXPECT_EQ(view.first(), 'j');
    EXPECT_EQ(view.last(), 's');
    EXPECT_EQ(view[3], '.');
    EXPECT_TRUE(view.some());
    EXPECT_STREQ(view.find("."), ".ps");
}

TEST(Str, views_the_shared_empty_text_when_there_is_none) {
    EXPECT_EQ(Str().c_str(), Str::StrEmpty);
    EXPECT_EQ(Str().size(), 0U);
    EXPECT_TRUE(Str().empty());
    EXPECT_FALSE(Str().some());
    EXPECT_EQ(Str().first(), '\0');
    EXPECT_EQ(Str(nullptr).c_str(), Str::StrEmpty);
    EXPECT_EQ(Str(nullptr).size(), 0U);
    EXPECT_STREQ(Str::StrEmpty, "");
}

TEST(Str, stores_pointer_and_length_as_they_are_given) {
    char const* text = "abcdef";
    EXPECT_EQ(Str(text, 3).size(), 3U);
    EXPECT_EQ(Str(text, 3).c_str(), text);
    EXPECT_EQ(Str(text, 0).size(), 0U);
    EXPECT_EQ(Str(text, 100).size(), 100U);
    EXPECT_EQ(Str(nullptr, 7).c_str(), nullptr);
    EXPECT_EQ(Str(nullptr, 7).size(), 7U);
}

TEST(Str, views_a_standard_string_with_its_size) {
    std::string const text("a\0b", 3);
    Str const view = text;
    EXPECT_EQ(view.size(), 3U);
    EXPECT_EQ(view.c_str(), text.c_str());
}

TEST(Str, assignment_copies_both_words) {
    Str view("first");
    Str const other("second", 2);
    view = other;
    EXPECT_EQ(view.c_str(), other.c_str());
    EXPECT_EQ(view.size(), 2U);
}

TEST(Str, turns_into_a_string_view_of_its_size) {
    Str const view("abcdef", 3);
    EXPECT_EQ(std::string_view(view), "abc");
    EXPECT_EQ(static_cast<std::string_view>(view).size(), 3U);
    EXPECT_EQ(std::string_view(Str("a\0b", 3)).size(), 3U);
}

TEST(Str, prints_as_its_text) {
    std::ostringstream out;
    out << Str("page") << BufStr<15>("-1");
    EXPECT_EQ(out.str(), "page-1");
}

TEST(Str, takes_every_integer_as_an_index) {
    enum Place { SECOND = 1 };
    Str const view("abc");
    EXPECT_EQ(view[0], 'a');
    EXPECT_EQ(view[1U], 'b');
    EXPECT_EQ(view[2L], 'c');
    EXPECT_EQ(view[std::uint64_t{2}], 'c');
    EXPECT_EQ(view[static_cast<short>(1)], 'b');
    EXPECT_EQ(view[SECOND], 'b');
    EXPECT_EQ(view[3], '\0');
}

TEST(Str, finds_the_first_occurrence) {
    Str const view("a.b.c");
    EXPECT_EQ(view.find("."), view.c_str() + 1);
    EXPECT_EQ(view.find("c"), view.c_str() + 4);
    EXPECT_EQ(view.find(""), view.c_str());
    EXPECT_EQ(view.find("x"), nullptr);
    EXPECT_EQ(view.find(nullptr), nullptr);
    EXPECT_STREQ(Str("abc", 1).find("c"), "c") << "the size is not looked at";
}

TEST(Str, begins_with_a_prefix_of_the_given_size) {
    struct Case {
        Row row;
        Str text;
        Str prefix;
        bool expected;
    };
    for (Case const& c : {Case{{}, "abc", "ab", true}, Case{{}, "abc", "abc", true}, Case{{}, "abc", "abcd", false},
                          Case{{}, "abc", "b", false}, Case{{}, "abc", "", true}, Case{{}, "", "", true},
                          Case{{}, "", "a", false}, Case{{}, "abc", Str("xyz", 0), true},
                          Case{{}, "abc", Str("abx", 2), true}, Case{{}, "abc", Str(nullptr, 0), true},
                          Case{{}, "abc", Str("abc", 10), true}, Case{{}, Str("ab", 1), "ab", true}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(c.text.beginWith(c.prefix), c.expected);
    }
    char const* same = "text";
    EXPECT_TRUE(Str(same, 2).beginWith(Str(same, 4)));
}

namespace {

struct SizedPair {
    Row row;
    Str left;
    Str right;
    bool expected;
};

SizedPair const SIZED_PAIRS[] = {
    {{}, Str("abcdef", 3), Str("abc", 3), true},
    {{}, Str("abc", 3), Str("abcdef", 3), true},
    {{}, Str("abcdef", 3), Str("abc", 0), false},
    {{}, Str("abc", 3), Str("abcdef", 0), false},
    {{}, Str("abc", 3), Str("abc", 0), true},
    {{}, Str("abc", 0), Str("abc", 3), false},
    {{}, Str("abc", 0), Str("abc", 0), true},
    {{}, Str("abc", 2), Str("abc", 0), true},
    {{}, Str("abc", 2), Str("abx", 2), true},
    {{}, Str("abc", 2), Str("abc", 3), false},
    {{}, Str("ab\0x", 4), Str("ab\0y", 4), true},
    {{}, Str("ab\0x", 4), Str("ac\0x", 4), false},
    {{}, Str("", 0), Str("", 0), true},
    {{}, Str("", 0), Str(), true},
    {{}, Str("a", 1), Str(nullptr, 0), false},
    {{}, Str("", 0), Str(nullptr, 0), true},
    {{}, Str("x", 0), Str(), false},
};

} // namespace

TEST(Str, Kept_text_01_the_right_hand_size_alone_decides_how_equality_compares) {
    for (SizedPair const& c : SIZED_PAIRS) {
        SCOPED_TRACE(c.row);
        std::string const own(c.left.c_str(), std::max<std::size_t>(std::strlen(c.left), c.left.size()));
        Str const left(own.c_str(), c.left.size()); // equal literals may be one object, which is always equal
        EXPECT_EQ(left == c.right, c.expected);
        EXPECT_EQ(left != c.right, !c.expected);
        EXPECT_EQ(left.eq(c.right.c_str(), c.right.size()), c.expected);
    }
    char const* same = "abc";
    EXPECT_TRUE(Str(same, 1) == Str(same, 3)) << "the same text is always equal";
}

TEST(Str, equality_reads_nothing_behind_a_terminator) {
    Exact<char> const a("ab");
    Exact<char> const b("ab");
    Exact<char> const c("ax");
    EXPECT_TRUE(Str(a, 100) == Str(b, 100));
    EXPECT_FALSE(Str(a, 100) == Str(c, 100));
    EXPECT_TRUE(Str(a, 100).beginWith(Str(b, 100)));
    EXPECT_EQ(Str(a).compare(b, 100), 0);
    EXPECT_EQ(Str("", 64), Exact<char>("")) << "and sizes do not matter for plain text";
}

TEST(Str, equality_sees_a_difference_at_every_place) {
    for (std::size_t size = 1; size < 150; ++size) {
        std::string const text(size, 'a');
        Exact<char> const left(text);
        ASSERT_TRUE(Str(left, size) == Str(Exact<char>(text), size)) << size;
        for (std::size_t place = 0; place < size; ++place) {
            for (char other : {'b', '\0', '\xE9'}) {
                std::string changed = text;
                changed[place] = other;
                ASSERT_FALSE(Str(left, size) == Str(Exact<char>(changed), size)) << size << ' ' << place;
                ASSERT_FALSE(Str(left, size) == changed) << size << ' ' << place;
                std::string both = text;
                both[place] = '\0';
                std::string tail = both;
                if (place + 1 < size) tail[place + 1] = other;
                ASSERT_TRUE(Str(Exact<char>(both), size) == Str(Exact<char>(tail), size)) << size << ' ' << place;
            }
        }
    }
}

TEST(Str, compares_for_equality_from_both_sides) {
    std::string const own("abc");
    Str const view(own);
    EXPECT_TRUE(view == "abc" && "abc" == view && view == std::string("abc") && std::string("abc") == view);
    EXPECT_TRUE(view != "ab" && "ab" != view && view != std::string("ab") && std::string("ab") != view);
    EXPECT_TRUE(Str("abc", 1) == "abc") << "plain text is compared whole";
    EXPECT_FALSE("abc" == Str(own.c_str(), 1)) << "the view stands on the right and decides";
    EXPECT_TRUE("a" == Str("abc", 1));
    EXPECT_TRUE(std::string("a") == Str("abc", 1));
    EXPECT_FALSE(Str("abc", 0) == own) << "the string's size is not 0, so sizes count";
    EXPECT_TRUE(std::string("abc") == Str(own.c_str(), 0));
    EXPECT_TRUE(view != nullptr && nullptr != view && Str() == nullptr && nullptr == Str());
}

namespace {

struct OrderedPair {
    Row row;
    char const* left;
    char const* right;
    int expected;
};

OrderedPair const ORDERED_PAIRS[] = {{{}, "a", "b", -1},
                                     {{}, "b", "a", 1},
                                     {{}, "a", "a", 0},
                                     {{}, "a", "ab", -1},
                                     {{}, "", "a", -1},
                                     {{}, "", "", 0},
                                     {{}, "z", "\xE9", -1},
                                     {{}, "\xFF", "\x01", 1},
                                     {{}, "a", nullptr, 1},
                                     {{}, "", nullptr, 0},
                                     {{}, "0123456789abcdefX", "0123456789abcdefY", -1}};

} // namespace

TEST(Str, Kept_text_02_ordering_does_not_look_at_sizes) {
    for (OrderedPair const& c : ORDERED_PAIRS) {
        SCOPED_TRACE(c.row);
        std::string const copy(c.left);
        Str const left(copy.c_str(), 1);
        Str const right(c.right, 1);
        EXPECT_EQ(left.compare(right), c.expected);
        EXPECT_EQ(left.compare(c.right), c.expected);
        EXPECT_EQ(left < right, c.expected < 0);
        EXPECT_EQ(left > right, c.expected > 0);
        EXPECT_EQ(left <= right, c.expected <= 0);
        EXPECT_EQ(left >= right, c.expected >= 0);
        if (c.right == nullptr) continue;
        EXPECT_EQ(left < c.right, c.expected < 0);
        EXPECT_EQ(left >= c.right, c.expected >= 0);
        EXPECT_EQ(c.left > right, c.expected > 0);
        EXPECT_EQ(c.left <= right, c.expected <= 0);
        EXPECT_EQ(left < std::string(c.right), c.expected < 0);
        EXPECT_EQ(left > std::string(c.right), c.expected > 0);
        EXPECT_EQ(std::string(c.left) <= right, c.expected <= 0);
        EXPECT_EQ(std::string(c.left) >= right, c.expected >= 0);
    }
    char const* same = "abc";
    EXPECT_EQ(Str(same, 1).compare(Str(same, 3)), 0);
    EXPECT_FALSE(Str(same, 1) < Str(same, 3));
    EXPECT_FALSE(Str(Exact<char>("ab"), 1) == Str("ab", 2)) << "equality disagrees with the order here";
}

TEST(Str, compares_a_number_of_bytes) {
    Str const view("abcdef");
    EXPECT_EQ(view.compare("abcxyz", 3), 0);
    EXPECT_LT(view.compare("abcxyz", 4), 0);
    EXPECT_GT(view.compare("abc", 4), 0);
    EXPECT_EQ(view.compare("xyz", 0), 0);
    EXPECT_EQ(view.compare(view.c_str(), 3), 0);
    EXPECT_GT(Str("\xE9").compare("z", 1), 0);
    EXPECT_EQ(signOf(view.compare("abd", 100)), -1);
}

TEST(Str, hashes_its_text_to_the_terminator) {
    EXPECT_EQ(Str("abc").hash(), hashDjb2("abc", 3));
    EXPECT_EQ(Str("abc", 1).hash(), hashDjb2("abc", 3));
    EXPECT_EQ(Str().hash(), 5381U);
}

TEST(Str, changes_case_of_the_given_bytes_only) {
    char text[] = "aB1z\0Q";
    Str::ToUpper(text, 3);
    EXPECT_STREQ(text, "AB1z");
    Str::ToLower(text, 6);
    EXPECT_EQ(std::string(text, 6), std::string("ab1z\0q", 6));
    Str::ToUpper(text, 0);
    EXPECT_EQ(text[0], 'a');
}

TEST(Str, knows_hexadecimal_digits) {
    std::string const digits = "0123456789abcdef";
    for (int value = 0; value < 256; ++value) {
        char const c = static_cast<char>(value);
        auto const place = digits.find(c >= 'A' && c <= 'F' ? static_cast<char>(c + 32) : c);
        int const expected = place == std::string::npos ? -1 : static_cast<int>(place);
        EXPECT_EQ(Str::hexToDigit(c), expected) << value;
        EXPECT_EQ(Str::isHexDigit(c), expected >= 0) << value;
        char out[3] = {'?', '?', '!'};
        Str::ch2hex(c, out);
        EXPECT_EQ(out[0], digits[static_cast<std::size_t>(value / 16)]);
        EXPECT_EQ(out[1], digits[static_cast<std::size_t>(value % 16)]);
        EXPECT_EQ(out[2], '!') << "no terminator is written";
        EXPECT_EQ(Str::decodeHexChar(out), c);
    }
}

TEST(Str, Kept_text_03_digits_that_are_none_count_255_modulo_256) {
    struct Case {
        Row row;
        char const* digits;
        int expected;
    };
    for (Case const& c : {Case{{}, "41", 0x41}, Case{{}, "fF", 0xFF}, Case{{}, "ZZ", 0xEF}, Case{{}, "1Z", 0x0F},
                          Case{{}, "Z1", 0xF1}, Case{{}, "00", 0}, Case{{}, "g0", 0xF0}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(static_cast<unsigned char>(Str::decodeHexChar(c.digits)), c.expected);
        EXPECT_EQ(Str().decodeHexChar(c.digits), Str::decodeHexChar(c.digits));
    }
}
