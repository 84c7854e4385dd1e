#include "zor_basis/text.h"

#include "tests/support/table.h"
#include "tests/text/string_kinds.h"

#include <gtest/gtest.h>

#include <climits>
#include <string>

using namespace ZOR_Basis;

namespace {

template <std::uint64_t N>
concept CanBe = requires {
    typename BufStr<N>;
};
static_assert(CanBe<15> && CanBe<255> && !CanBe<14> && !CanBe<16> && !CanBe<0> && !CanBe<31>);

template <class String>
class BufStrOf : public testing::Test {};

} // namespace

using Sizes = testing::Types<BufStr<15>, BufStr<255>>;
TYPED_TEST_SUITE(BufStrOf, Sizes, );

TYPED_TEST(BufStrOf, breathes) {
    TypeParam name("job");
    name << "-" << 42;
    EXPECT_EQ(name, "job-42");
    EXPECT_EQ(BufStr<255>(name), BufStr<15>("job-42"));
}

TYPED_TEST(BufStrOf, takes_standard_strings) {
    std::string const source("abc");
    TypeParam s(source);
    EXPECT_EQ(s, "abc");
    s = std::string("xyz");
    EXPECT_EQ(s, source.substr(0, 0) + "xyz");
    s += source;
    EXPECT_EQ(s, "xyzabc");
    s = std::string();
    EXPECT_TRUE(s.empty());
    s = std::string("a\0b", 3);
    EXPECT_EQ(contentOf(s), std::string("a\0\0", 3));
    s += std::string("c\0d", 3);
    EXPECT_EQ(contentOf(s), std::string("a\0\0c\0\0", 6));
    EXPECT_EQ(TypeParam(std::string("\0ab", 3)).size(), 0U) << "a text that begins with its terminator is empty";
}

TYPED_TEST(BufStrOf, appends_the_first_bytes_of_a_standard_string) {
    std::string const source("abcdef");
    TypeParam s;
    EXPECT_EQ(&s.add(source, 2), &s);
    EXPECT_EQ(s, "ab");
    s.clear();
    s.add(source, 0);
    EXPECT_EQ(s, "abcdef");
    s.clear();
    s.add(source, 7);
    EXPECT_EQ(s, "abcdef");
    s.add(std::string(), 3);
    EXPECT_EQ(s, "abcdef");
}

TYPED_TEST(BufStrOf, appends_bytes_of_every_integer_type) {
    TypeParam s;
    s.add('a').add(98).add(99U).add(static_cast<unsigned char>('d')).add(0).add('\0');
    s += 'e';
    s += 102;
    EXPECT_EQ(s, "abcdef");
    s.add('\xE9');
    EXPECT_EQ(s.last(), '\xE9');
}

TYPED_TEST(BufStrOf, takes_enumerators_as_their_numbers) {
    enum Letter { LETTER_A = 'A' };
    TypeParam s;
    s.add(LETTER_A) += LETTER_A;
    s << LETTER_A;
    EXPECT_STREQ(s, "AA65");
}

TYPED_TEST(BufStrOf, chains_what_cuts_and_clears) {
    TypeParam s("abcdef");
    s.cut().cut(2).add("x").extendBuf(40).resize().add("y");
    EXPECT_STREQ(s, "abxy");
    EXPECT_STREQ(s.clear().add("z"), "z");
    HeapStr h("abc");
    EXPECT_STREQ(h.cut().cut(1), "a");
    EXPECT_STREQ(h.clear().set("x"), "x");
    WBStr w(ZB_W("abcdef"));
    w.cut().cut(2).add(ZB_W("x")).extendBuf(40).resize().setSize(2).add(ZB_W("y"));
    EXPECT_TRUE(w == ZB_W("aby"));
    EXPECT_TRUE(w.clear().add(ZB_W("z")) == ZB_W("z"));
    WFxStr view;
    EXPECT_EQ(view.set(ZB_W("abc")).size(), 3U);
    EXPECT_TRUE(view.clear().empty());
}

TYPED_TEST(BufStrOf, streams_texts_and_numbers) {
    struct Case {
        Row row;
        int number;
        char const* expected;
    };
    for (Case const& c : {Case{{}, 0, "0"}, Case{{}, -1, "-1"}, Case{{}, 42, "42"}, Case{{}, INT_MAX, "2147483647"},
                          Case{{}, INT_MIN, "-2147483648"}}) {
        SCOPED_TRACE(c.row);
        TypeParam s;
        EXPECT_EQ(&(s << c.number), &s);
        EXPECT_EQ(s, c.expected);
    }
    TypeParam mixed;
    mixed << "a" << Str("bcd", 2) << 1U << 2L << std::uint64_t{3} << static_cast<short>(4) << BufStr<15>("e")
          << std::string("f");
    EXPECT_EQ(mixed, "abc1234ef");
}

TYPED_TEST(BufStrOf, Kept_text_15_streams_a_character_as_its_number_and_appends_it_as_itself) {
    TypeParam text;
    text << 'a' << static_cast<signed char>(-1) << static_cast<unsigned char>(255) << true;
    EXPECT_EQ(text, "97-12551");
    text += 'a';
    EXPECT_EQ(text, "97-12551a");
}

namespace {

struct NewTail {
    Row row;
    char const* before;
    std::uint64_t position;
    char const* source;
    std::uint64_t length;
    char const* after;
};

NewTail const NEW_TAILS[] = {{{}, "abcd", 2, "xyz", 0, "abxyz"}, {{}, "abcd", 2, "xyz", 1, "abx"},
                             {{}, "abcd", 2, "", 0, "ab"},       {{}, "abcd", 2, nullptr, 5, "ab"},
                             {{}, "abcd", 4, "x", 0, "abcdx"},   {{}, "abcd", 9, "x", 0, "abcdx"},
                             {{}, "abcd", 0, "x", 0, "x"},       {{}, "abcd", 9, "", 0, "abcd"}};

} // namespace

TYPED_TEST(BufStrOf, replaces_its_tail) {
    for (NewTail const& c : NEW_TAILS) {
        SCOPED_TRACE(c.row);
        TypeParam s(c.before);
        EXPECT_EQ(&s.replaceTail(c.position, c.source, c.length), &s);
        EXPECT_EQ(s, c.after);
        EXPECT_TRUE(isTerminated(s));
        TypeParam viaView(c.before);
        viaView.replaceTail(c.position, Str(c.source, c.length));
        EXPECT_EQ(viaView, c.after);
    }
    TypeParam own("abcdef");
    own.replaceTail(1, own.c_str() + 2);
    EXPECT_EQ(own, "acdef");
    own.replaceTail(3, own);
    EXPECT_EQ(own, "acdacdef");
    TypeParam full;
    for (std::uint64_t i = 0; i < Kind<TypeParam>::INSIDE; ++i) full += 'x';
    full.replaceTail(1, full);
    EXPECT_EQ(full.sizeBuf(), Kind<TypeParam>::INSIDE + 1);
    EXPECT_EQ(contentOf(full), std::string(Kind<TypeParam>::INSIDE + 1, 'x'));
}

TYPED_TEST(BufStrOf, changes_the_case_of_all_its_bytes) {
    TypeParam s("aB-cD");
    s[2] = '\0';
    s.toUpper();
    EXPECT_EQ(contentOf(s), std::string("AB\0CD", 5));
    s.toLower();
    EXPECT_EQ(contentOf(s), std::string("ab\0cd", 5));
}

TYPED_TEST(BufStrOf, writes_hexadecimal_digits) {
    struct Case {
        Row row;
        char const* source;
        char const* expected;
    };
    for (Case const& c : {Case{{}, "AZ", "415a"}, Case{{}, "\xFE", "fe"}, Case{{}, "\x01\x7F\x80", "017f80"},
                          Case{{}, "", ""}, Case{{}, nullptr, ""}}) {
        SCOPED_TRACE(c.row);
        TypeParam s("old");
        s.toHex(c.source);
        EXPECT_EQ(s, c.expected);
    }
    std::uint64_t const n = Kind<TypeParam>::INSIDE;
    TypeParam grown;
    grown.toHex(std::string(n, 'A').c_str());
    EXPECT_EQ(grown.sizeBuf(), 2 * n) << "exactly the digits";
    TypeParam just;
    just.toHex(std::string(n / 2, 'A').c_str());
    EXPECT_TRUE(isInside(just));
    TypeParam own("ABC");
    own.toHex(own.c_str());
    EXPECT_EQ(own, "414243");
    own.toHex(own.c_str() + 4);
    EXPECT_EQ(own, "3433");
}

TYPED_TEST(BufStrOf, reads_hexadecimal_digits) {
    struct Case {
        Row row;
        char const* digits;
        std::string expected;
    };
    for (Case const& c :
         {Case{{}, "4142", "xAB"}, Case{{}, "", "x"}, Case{{}, nullptr, "x"}, Case{{}, "fE", "x\xFE"},
          Case{{}, "ZZ", "x\xEF"}, Case{{}, "1Z", "x\x0F"}, Case{{}, "4", "x"}, Case{{}, "414", "xA"}}) {
        SCOPED_TRACE(c.row);
        TypeParam s("x");
        s.fromHex(c.digits);
        EXPECT_EQ(contentOf(s), c.expected);
        EXPECT_TRUE(isTerminated(s));
    }
    std::string const odd = "41424";
    TypeParam exact;
    exact.fromHex(Exact<char>(odd));
    EXPECT_EQ(exact, "AB") << "nothing behind the terminator is read";
    TypeParam own("4142");
    own.fromHex(own.c_str());
    EXPECT_EQ(own, "4142AB");
}

TYPED_TEST(BufStrOf, Kept_text_11_a_pair_that_gives_zero_appends_nothing) {
    TypeParam s;
    s.fromHex("41004200");
    EXPECT_EQ(s, "AB");
    EXPECT_EQ(s.size(), 2U);
    s.fromHex("00");
    EXPECT_EQ(s.size(), 2U);
}

TYPED_TEST(BufStrOf, hexadecimal_digits_come_back_as_the_text) {
    std::string all;
    for (int value = 1; value < 256; ++value) all += static_cast<char>(value);
    BufStr<255> digits;
    digits.toHex(all.c_str());
    TypeParam back;
    back.fromHex(digits);
    EXPECT_EQ(contentOf(back), all);
    EXPECT_EQ(back.sizeBuf(), 255U) << "a byte at a time, so the capacity is exact";
}

TEST(BufStr, moves_between_its_sizes) {
    BufStr<255> const path(std::string(20, 'p'));
    BufStr<15> name = path;
    EXPECT_EQ(name.sizeBuf(), 21U);
    EXPECT_EQ(name, path);
    BufStr<255> back;
    back = name;
    EXPECT_EQ(back.sizeBuf(), 255U);
    back += name;
    EXPECT_EQ(back.size(), 40U);
}

TEST(BufStr, Kept_text_04_fifteen_bytes_assigned_to_the_short_string_make_a_block_of_sixteen) {
    BufStr<15> assigned("abcdefghijklmno");
    EXPECT_EQ(assigned.sizeBuf(), 16U);
    BufStr<15> appended;
    appended.add("abcdefghijklmno");
    EXPECT_EQ(appended.sizeBuf(), 15U);
    appended += 'p';
    EXPECT_EQ(appended.sizeBuf(), 16U);
}
