#include "zor_basis/text/heap_str.h"

#include "tests/support/table.h"
#include "tests/text/call_content.h"
#include "tests/text/string_kinds.h"

#include <gtest/gtest.h>

#include <unordered_set>
#include <utility>

using namespace ZOR_Basis;

static_assert(sizeof(HeapStr) == 24);

namespace {

class Opened : public HeapStr {
public:
    using HeapStr::alloc;
    using HeapStr::copy;
    using HeapStr::free;
    using HeapStr::HeapStr;
    using HeapStr::reassign;
    using HeapStr::setEmpty;
    using HeapStr::operator=;
    std::uint64_t capacity() const { return capacity_; }
};

} // namespace

TEST(HeapStr, breathes) {
    HeapStr owner("operator");
    EXPECT_EQ(owner, "operator");
    owner.set("guest");
    EXPECT_EQ(owner.size(), 5U);
    owner.clear();
    EXPECT_EQ(owner.c_str(), Str::StrEmpty);
}

TEST(HeapStr, holds_exactly_what_it_is_given) {
    std::string const source("abcdef");
    struct Case {
        Row row;
        HeapStr made;
        std::string expected;
    };
    for (Case const& c :
         {Case{{}, HeapStr(), ""}, Case{{}, HeapStr("abc"), "abc"}, Case{{}, HeapStr(nullptr), ""},
          Case{{}, HeapStr("abc", 2), "ab"}, Case{{}, HeapStr(nullptr, 2), ""}, Case{{}, HeapStr(source), "abcdef"},
          Case{{}, HeapStr(std::string()), ""}, Case{{}, HeapStr(Str("abc", 1)), "a"},
          Case{{}, HeapStr(BufStr<15>("abc")), "abc"}, Case{{}, HeapStr(HeapStr("abc")), "abc"},
          Case{{}, HeapStr(Exact<char>("abc"), 5), std::string("abc\0\0", 5)},
          Case{{}, HeapStr(std::string("a\0b", 3)), std::string("a\0\0", 3)}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(contentOfAny(c.made), c.expected);
        EXPECT_EQ(c.made.c_str()[c.made.size()], '\0');
        EXPECT_EQ(c.made.c_str() == Str::StrEmpty, c.expected.empty());
    }
}

TEST(HeapStr, Kept_text_13_a_length_of_zero_is_empty_and_never_measured) {
    EXPECT_TRUE(HeapStr("abc", 0).empty());
    EXPECT_TRUE(HeapStr(Str("x", 0)).empty());
    EXPECT_EQ(HeapStr(Str("x", 0)).c_str(), Str::StrEmpty);
    HeapStr s("old");
    s.set("abc", 0);
    EXPECT_EQ(s.c_str(), Str::StrEmpty);
    s = "old";
    s = Str("abc", 0);
    EXPECT_TRUE(s.empty());
    EXPECT_EQ(contentOfAny(HeapStr("\0ab", 3)), std::string(3, '\0')) << "an empty text keeps its length";
}

TEST(HeapStr, assigns_every_kind_of_source) {
    Opened s;
    s = "abc";
    EXPECT_EQ(s, "abc");
    s = Str("defg", 2);
    EXPECT_EQ(s, "de");
    s = std::string("hij");
    EXPECT_EQ(s, "hij");
    static_cast<HeapStr&>(s) = HeapStr("klm");
    EXPECT_EQ(s, "klm");
    EXPECT_EQ(&s.set("n"), &s);
    EXPECT_EQ(s.capacity(), 1U);
    EXPECT_EQ(&s.set("opq", 2), &s);
    EXPECT_EQ(s, "op");
    struct Case {
        Row row;
        char const* source;
        bool given;
    };
    for (Case const& c : {Case{{}, nullptr, false}, Case{{}, nullptr, true}, Case{{}, "", false}}) {
        SCOPED_TRACE(c.row);
        s.set("again");
        EXPECT_EQ(&(c.given ? s.set(c.source, 3) : s.set(c.source)), &s);
        EXPECT_EQ(s.c_str(), Str::StrEmpty);
        EXPECT_EQ(s.capacity(), 0U);
    }
    s.set("again");
    static_cast<HeapStr&>(s) = nullptr;
    EXPECT_EQ(s.c_str(), Str::StrEmpty);
}

TEST(HeapStr, uses_its_block_again_where_it_fits_exactly) {
    Opened s("abcd");
    char const* block = s.c_str();
    s.set("wxyz");
    EXPECT_EQ(s.c_str(), block);
    EXPECT_EQ(s, "wxyz");
    s.cut(2);
    EXPECT_EQ(s.capacity(), 4U);
    s.set("1234");
    EXPECT_EQ(s.c_str(), block);
    s.set("12");
    EXPECT_EQ(s.capacity(), 2U);
}

TEST(HeapStr, takes_parts_of_its_own_text) {
    Opened s("abcdef");
    s.set(s.c_str() + 2);
    EXPECT_EQ(s, "cdef");
    s.set(s.c_str() + 1, 2);
    EXPECT_EQ(s, "de");
    s.set(s.c_str() + 1, 2);
    EXPECT_EQ(contentOfAny(s), std::string("e\0", 2)) << "in the same block";
    s.set("abcdef");
    s.cut(3);
    HeapStr const& same = s;
    static_cast<HeapStr&>(s) = same;
    EXPECT_EQ(s, "abc");
    EXPECT_EQ(s.capacity(), 3U);
    static_cast<HeapStr&>(s) = s.c_str();
    EXPECT_EQ(s, "abc");
}

TEST(HeapStr, a_copy_is_independent_and_a_move_copies) {
    HeapStr source("abc");
    HeapStr copy(source);
    EXPECT_NE(copy.c_str(), source.c_str());
    HeapStr const moved(std::move(copy));
    EXPECT_EQ(moved, "abc");
    EXPECT_EQ(copy, "abc"); // NOLINT(bugprone-use-after-move)
}

TEST(HeapStr, cuts_without_touching_the_shared_empty_text) {
    Opened s("abcd");
    s.cut();
    EXPECT_EQ(s, "abc");
    s.cut(1);
    s.cut(9);
    EXPECT_EQ(s, "a");
    s.cut(0);
    s.cut();
    EXPECT_TRUE(s.empty());
    EXPECT_EQ(s.capacity(), 4U);
    HeapStr none;
    none.cut();
    none.cut(0);
    none.cut(5);
    none.toLower();
    none.toUpper();
    EXPECT_EQ(none.c_str(), Str::StrEmpty);
    EXPECT_STREQ(Str::StrEmpty, "");
}

TEST(HeapStr, changes_case) {
    HeapStr s("aBc");
    EXPECT_EQ(&s.toUpper(), &s);
    EXPECT_EQ(s, "ABC");
    EXPECT_EQ(&s.toLower(), &s);
    EXPECT_EQ(s, "abc");
}

TEST(HeapStr, its_machinery_does_single_steps) {
    Opened s;
    s.alloc(3);
    EXPECT_EQ(s.size(), 3U);
    EXPECT_EQ(s.capacity(), 3U);
    EXPECT_NE(s.c_str(), Str::StrEmpty);
    s.free();
    s.setEmpty();
    EXPECT_EQ(s.size(), 0U);
    EXPECT_EQ(s.capacity(), 3U) << "the capacity is left to the caller";
    s.copy("ab", 2);
    EXPECT_EQ(s, "ab");
    s.reassign("cde", 3);
    EXPECT_EQ(s, "cde");
    s.reassign("x", 0);
    EXPECT_EQ(s.c_str(), Str::StrEmpty);
    EXPECT_EQ(s.capacity(), 0U);
}

TEST(HeapStr, is_a_key_of_hashed_containers) {
    std::unordered_set<HeapStr> const set{HeapStr("x"), HeapStr("x"), HeapStr("y")};
    EXPECT_EQ(set.size(), 2U);
    EXPECT_EQ(std::hash<HeapStr>()(HeapStr("ab\0c", 4)), std::hash<HeapStr>()(HeapStr("ab", 2)));
}

TEST(HeapStr, sets_a_text) {
    HeapStr text;
    EXPECT_EQ(contentOfAny(text.set("abc")), "abc");
    EXPECT_EQ(contentOfAny(text.set("abc", 2)), "ab");
    EXPECT_EQ(contentOfAny(text.set("abc", 0)), "");
    EXPECT_EQ(contentOfAny(text.set(nullptr)), "");
}
