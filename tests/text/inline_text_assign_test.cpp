// Construction and assignment of BufStr<15>, BufStr<255> and WBStr.

#include "tests/support/table.h"
#include "tests/text/inline_text_suite.h"

#include <gtest/gtest.h>

#include <string_view>
#include <utility>

using namespace ZOR_Basis;

namespace {

template <class String>
class InlineTextAssign : public InlineTextSuite<String> {};
TYPED_TEST_SUITE(InlineTextAssign, InlineTextKinds, InlineTextNames);

} // namespace

TYPED_TEST(InlineTextAssign, makes_copies_of_every_kind_of_source) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    Text const source = make<String>("abc");
    struct Case {
        Row row;
        String made;
        char const* expected;
    };
    for (Case const& c :
         {Case{{}, String(source.c_str()), "abc"}, Case{{}, String(source.c_str(), 2), "ab"},
          Case{{}, String(source.c_str(), 0), "abc"}, Case{{}, String(View(source.c_str(), 2)), "ab"},
          Case{{}, String(View(source.c_str(), 0)), "abc"}, Case{{}, String(String(source.c_str())), "abc"},
          Case{{}, String(static_cast<Char const*>(nullptr)), ""}, Case{{}, String(nullptr, 5), ""},
          Case{{}, String(View(nullptr, 5)), ""}, Case{{}, String(make<String>("").c_str(), 5), ""},
          Case{{}, String(make<String>(std::string_view("\0ab", 3)).c_str(), 3), ""}, Case{{}, String(View()), ""}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(contentOf(c.made), make<String>(c.expected));
        EXPECT_TRUE(isInside(c.made) && isTerminated(c.made));
    }
}

TYPED_TEST(InlineTextAssign, a_copy_is_independent_and_begins_inside) {
    using String = TypeParam;
    using Char = CharOf<String>;
    String const source = TestFixture::onHeap(make<String>("abc"));
    ASSERT_FALSE(isInside(source));
    String copy(source);
    EXPECT_TRUE(isInside(copy)) << "short text goes inside, wherever it came from";
    copy[0] = Char('x');
    EXPECT_EQ(contentOf(source), make<String>("abc"));
    String moved(std::move(copy));
    EXPECT_EQ(contentOf(moved), make<String>("xbc"));
    EXPECT_EQ(contentOf(copy), make<String>("xbc")) << "a move copies"; // NOLINT(bugprone-use-after-move)
}

TYPED_TEST(InlineTextAssign, Kept_text_04_assigning_needs_one_unit_more_than_the_text) {
    using String = TypeParam;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (bool given : {false, true}) {
        auto const length = [given](std::uint64_t n) { return given ? n : 0; };
        String const fits(TestFixture::letters(N - 1).c_str(), length(N - 1));
        EXPECT_TRUE(isInside(fits));
        EXPECT_EQ(fits.sizeBuf(), N);
        String const spills(TestFixture::letters(N).c_str(), length(N));
        EXPECT_FALSE(isInside(spills));
        EXPECT_EQ(spills.sizeBuf(), N + 1);
        EXPECT_EQ(contentOf(spills), TestFixture::letters(N));
        String grown;
        grown.copy(TestFixture::letters(N + 5).c_str(), length(N + 5));
        EXPECT_EQ(grown.sizeBuf(), N + 6);
        grown.copy(TestFixture::letters(N + 6).c_str(), length(N + 6));
        EXPECT_EQ(grown.sizeBuf(), N + 7) << "a block is outgrown in the same way";
    }
    String const inside = TestFixture::appended(N);
    ASSERT_TRUE(isInside(inside));
    String const copy(inside);
    EXPECT_FALSE(isInside(copy)) << "even a copy of an inside text";
    EXPECT_EQ(copy.sizeBuf(), N + 1);
}

TYPED_TEST(InlineTextAssign, Kept_text_06_a_given_length_stays_the_size_and_zeros_follow_the_terminator) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (std::uint64_t claimed : {std::uint64_t{4}, std::uint64_t{10}, N - 1, N, N + 20}) {
        Exact<Char> const source(make<String>("abc"));
        Text expected = make<String>("abc");
        expected.resize(claimed);
        String const made(source, claimed);
        EXPECT_EQ(contentOf(made), expected);
        String copied = TestFixture::appended(N);
        copied.copy(source, claimed);
        EXPECT_EQ(contentOf(copied), expected);
        String added(make<String>("x").c_str());
        added.add(source, claimed);
        EXPECT_EQ(contentOf(added), Char('x') + expected);
        added.add(make<String>("y").c_str());
        EXPECT_EQ(contentOf(added).front(), Char('x'));
        String inserted(make<String>("[]").c_str());
        inserted.insert(1, source, claimed);
        EXPECT_EQ(contentOf(inserted), Char('[') + expected + Char(']'));
        String replaced(make<String>("[--]").c_str());
        replaced.replace(1, 2, View(source, claimed));
        EXPECT_EQ(contentOf(replaced), Char('[') + expected + Char(']'));
        EXPECT_TRUE(isTerminated(made) && isTerminated(copied) && isTerminated(added) && isTerminated(inserted));
    }
}

TYPED_TEST(InlineTextAssign, Kept_text_06_a_given_length_pads_behind_an_inner_zero) {
    using String = TypeParam;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    Text const zeroInside = make<String>(std::string_view("ab\0cd", 5));
    EXPECT_EQ(contentOf(String(zeroInside.c_str(), 5)), make<String>(std::string_view("ab\0\0\0", 5)));
    EXPECT_EQ(contentOf(String(View(zeroInside.c_str(), 5))), make<String>(std::string_view("ab\0\0\0", 5)));
}

TYPED_TEST(InlineTextAssign, Kept_text_06_the_rule_holds_wherever_the_zero_lies) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    for (std::uint64_t size :
         {1U, 2U, 3U, 4U, 7U, 8U, 9U, 14U, 15U, 16U, 17U, 31U, 32U, 33U, 63U, 64U, 65U, 127U, 200U, 254U, 255U, 300U}) {
        for (std::uint64_t zero = 1; zero < size; ++zero) {
            String source = TestFixture::appended(size);
            source[zero] = Char();
            Text expected = TestFixture::letters(size);
            expected.resize(zero);
            expected.resize(size);
            String const copy(source);
            ASSERT_EQ(contentOf(copy), expected) << size << ' ' << zero;
            String assigned(make<String>("?").c_str());
            assigned = source;
            ASSERT_EQ(contentOf(assigned), expected) << size << ' ' << zero;
            String const view(View(source, size));
            ASSERT_EQ(contentOf(view), expected) << size << ' ' << zero;
            Text const exact = TestFixture::letters(zero);
            ASSERT_EQ(contentOf(String(Exact<Char>(exact), size)), expected) << size << ' ' << zero;
        }
    }
}

TYPED_TEST(InlineTextAssign, assigns_every_kind_of_source) {
    using String = TypeParam;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    String s(make<String>("old").c_str());
    Text const source = make<String>("abcdef");
    s = source.c_str();
    EXPECT_EQ(contentOf(s), make<String>("abcdef"));
    s = View(source.c_str(), 2);
    EXPECT_EQ(contentOf(s), make<String>("ab"));
    s = View(source.c_str(), 0);
    EXPECT_EQ(contentOf(s), make<String>("abcdef"));
    s = String(make<String>("xyz").c_str());
    EXPECT_EQ(contentOf(s), make<String>("xyz"));
    EXPECT_EQ(&s.copy(source.c_str(), 3), &s);
    EXPECT_EQ(contentOf(s), make<String>("abc"));
    s = nullptr;
    EXPECT_EQ(s.size(), 0U);
    s = source.c_str();
    s = make<String>("").c_str();
    EXPECT_EQ(s.size(), 0U);
    s = source.c_str();
    EXPECT_EQ(&s.copy(nullptr, 3), &s);
    EXPECT_EQ(s.size(), 0U);
    EXPECT_TRUE(isTerminated(s));
}

TYPED_TEST(InlineTextAssign, assigning_itself_or_its_own_text_changes_nothing) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s = TestFixture::appended(N);
    s[1] = Char();
    Text const before = contentOf(s);
    String const& same = s;
    s = same;
    s = static_cast<View const&>(same);
    s = static_cast<Char const*>(same);
    EXPECT_EQ(contentOf(s), before);
    EXPECT_TRUE(isInside(s)) << "assigning another text of this size would move it to the heap";
}

TYPED_TEST(InlineTextAssign, assigns_parts_of_its_own_text) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (bool heap : {false, true}) {
        auto const start = [&] {
            return heap ? TestFixture::onHeap(make<String>("0123456789")) : String(make<String>("0123456789").c_str());
        };
        String s = start();
        s = static_cast<Char const*>(s) + 3;
        EXPECT_EQ(contentOf(s), make<String>("3456789"));
        s = start();
        s = View(static_cast<Char const*>(s), 4);
        EXPECT_EQ(contentOf(s), make<String>("0123")) << "a view of the text is not the string itself";
        s = start();
        s.copy(static_cast<Char const*>(s) + 2, 3);
        EXPECT_EQ(contentOf(s), make<String>("234"));
        s = start();
        s.copy(static_cast<Char const*>(s) + 8, N + 30);
        Text expected = make<String>("89");
        expected.resize(N + 30);
        EXPECT_EQ(contentOf(s), expected);
        s = start();
        s.copy(static_cast<Char const*>(s) + 8, 12);
        expected.resize(12);
        EXPECT_EQ(contentOf(s), expected);
    }
}
