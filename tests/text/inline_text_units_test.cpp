// Single units of BufStr<15>, BufStr<255> and WBStr by index and in NextLatin, and their hashes.

#include "tests/support/table.h"
#include "tests/text/inline_text_suite.h"

#include <gtest/gtest.h>

#include <functional>
#include <limits>
#include <unordered_set>

using namespace ZOR_Basis;

namespace {

template <class String>
class InlineTextUnits : public InlineTextSuite<String> {};
TYPED_TEST_SUITE(InlineTextUnits, InlineTextKinds, InlineTextNames);

} // namespace

TYPED_TEST(InlineTextUnits, gives_units_by_index) {
    using String = TypeParam;
    using Char = CharOf<String>;
    enum Place { SECOND = 1 };
    String s(make<String>("abc").c_str());
    s[0] = Char('x');
    s[1U] = Char('y');
    s[static_cast<short>(2)] = Char('z');
    EXPECT_EQ(contentOf(s), make<String>("xyz"));
    String const& view = s;
    EXPECT_EQ(view[0], Char('x'));
    EXPECT_EQ(view[SECOND], Char('y'));
    s.getBuf()[3] = Char('!');
    EXPECT_EQ(view[3], Char()) << "at the size there is a zero, whatever lies there";
    EXPECT_EQ(view[4L], Char());
    EXPECT_EQ(view[std::numeric_limits<std::uint64_t>::max()], Char());
    EXPECT_EQ(view[-1], Char());
}

TYPED_TEST(InlineTextUnits, counts_in_letters) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    struct Case {
        Row row;
        char const* before;
        char const* after;
    };
    for (Case const& c : {Case{{}, "", "a"}, Case{{}, "a", "b"}, Case{{}, "y", "z"}, Case{{}, "z", "aa"},
                          Case{{}, "az", "ba"}, Case{{}, "zz", "aaa"}, Case{{}, "abz", "aca"}, Case{{}, "zy", "zz"}}) {
        SCOPED_TRACE(c.row);
        String s(make<String>(c.before).c_str());
        s.NextLatin();
        EXPECT_EQ(contentOf(s), make<String>(c.after));
        EXPECT_TRUE(isTerminated(s));
    }
    String counter;
    for (int i = 0; i < 26 + 26 * 26; ++i) counter.NextLatin();
    EXPECT_EQ(contentOf(counter), make<String>("zz"));
    String full;
    for (std::uint64_t i = 0; i < N; ++i) full += Char('z');
    full.NextLatin();
    EXPECT_EQ(full.sizeBuf(), N + 1) << "the new letter is appended";
    EXPECT_EQ(contentOf(full), Text(N + 1, Char('a')));
}

TYPED_TEST(InlineTextUnits, counts_from_a_place_leftwards) {
    using String = TypeParam;
    String s(make<String>("azzq").c_str());
    String::NextLatin(s, 2);
    EXPECT_EQ(contentOf(s), make<String>("baaq"));
    String::NextLatin(s, 0);
    EXPECT_EQ(contentOf(s), make<String>("caaq"));
    String::NextLatin(s, 4);
    EXPECT_EQ(contentOf(s), make<String>("caaq")) << "behind the end nothing happens";
    String zs(make<String>("zzq").c_str());
    String::NextLatin(zs, 1);
    EXPECT_EQ(contentOf(zs), make<String>("aaqa"));
    String empty;
    String::NextLatin(empty, 0);
    EXPECT_EQ(contentOf(empty), make<String>("a"));
}

TYPED_TEST(InlineTextUnits, Kept_text_12_whatever_is_no_z_is_incremented) {
    using String = TypeParam;
    struct Case {
        Row row;
        char const* before;
        char const* after;
    };
    for (Case const& c : {Case{{}, "Z", "["}, Case{{}, "A9", "A:"}, Case{{}, "9z", ":a"}, Case{{}, "-zz", ".aa"}}) {
        SCOPED_TRACE(c.row);
        String s(make<String>(c.before).c_str());
        s.NextLatin();
        EXPECT_EQ(contentOf(s), make<String>(c.after));
    }
}

TYPED_TEST(InlineTextUnits, is_a_key_of_hashed_containers) {
    using String = TypeParam;
    using Char = CharOf<String>;
    std::hash<String> const hash;
    EXPECT_EQ(hash(String(make<String>("abc").c_str())), hash(TestFixture::onHeap(make<String>("abc"))));
    EXPECT_NE(hash(String(make<String>("abc").c_str())), hash(String(make<String>("abd").c_str())));
    String a(make<String>("ab-d").c_str());
    String b(make<String>("ab-e").c_str());
    EXPECT_NE(hash(a), hash(b));
    a[2] = Char();
    b[2] = Char();
    EXPECT_TRUE(a == b);
    EXPECT_EQ(hash(a), hash(b)) << "what is equal up to an inner zero hashes to the same value";
    std::unordered_set<String> const set{String(make<String>("x").c_str()), String(make<String>("x").c_str())};
    EXPECT_EQ(set.size(), 1U);
}
