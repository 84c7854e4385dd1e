// The inside area and the heap block of BufStr<15>, BufStr<255> and WBStr; one suite for all three.

#include "tests/support/table.h"
#include "tests/text/inline_text_suite.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <type_traits>

using namespace ZOR_Basis;

static_assert(sizeof(BufStr<15>) == 32 && sizeof(BufStr<255>) == 272 && sizeof(WBStr) == 536);
static_assert(!std::is_polymorphic_v<BufStr<15>> && std::is_polymorphic_v<WBStr>);
static_assert(!std::has_virtual_destructor_v<WBStr>);

namespace {

template <class String>
class InlineTextArea : public InlineTextSuite<String> {};
TYPED_TEST_SUITE(InlineTextArea, InlineTextKinds, InlineTextNames);

#if defined(__GNUC__)
#pragma GCC diagnostic ignored "-Wnon-virtual-dtor" // as WBStr itself, never deleted through a base
#endif

template <class String>
struct OpenedText : String {
    using String::CopyIfTooLong;
    using String::String;
};

} // namespace

TYPED_TEST(InlineTextArea, breathes) {
    using String = TypeParam;
    using Char = CharOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s(make<String>("tray").c_str());
    s += Char('1');
    EXPECT_EQ(contentOf(s), make<String>("tray1"));
    EXPECT_TRUE(isInside(s));
    s.add(TestFixture::letters(N).c_str());
    EXPECT_FALSE(isInside(s));
    EXPECT_EQ(s.size(), 5 + N);
}

TYPED_TEST(InlineTextArea, begins_empty_and_inside) {
    using String = TypeParam;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String const s;
    EXPECT_TRUE(isInside(s) && isTerminated(s));
    EXPECT_EQ(s.size(), 0U);
    EXPECT_EQ(s.sizeBuf(), N);
}

TYPED_TEST(InlineTextArea, Kept_text_05_appending_fills_the_area_to_its_last_unit) {
    using String = TypeParam;
    using Char = CharOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s = TestFixture::appended(N);
    EXPECT_TRUE(isInside(s) && isTerminated(s));
    EXPECT_EQ(s.sizeBuf(), N);
    EXPECT_EQ(contentOf(s), TestFixture::letters(N));
    s += Char('!');
    EXPECT_FALSE(isInside(s));
    EXPECT_EQ(s.sizeBuf(), N + 1);
    EXPECT_EQ(contentOf(s), TestFixture::letters(N) + Char('!'));
    String whole;
    whole.add(TestFixture::letters(N).c_str());
    EXPECT_TRUE(isInside(whole));
    String given;
    given.add(TestFixture::letters(N).c_str(), N);
    EXPECT_TRUE(isInside(given));
    given.add(TestFixture::letters(1).c_str(), 1);
    EXPECT_EQ(given.sizeBuf(), N + 1);
}

TYPED_TEST(InlineTextArea, a_growing_string_keeps_its_text_up_to_an_inner_zero) {
    using String = TypeParam;
    using Char = CharOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s(make<String>("abcd").c_str());
    s[1] = Char();
    s.extendBuf(N + 1);
    EXPECT_EQ(contentOf(s), make<String>(std::string_view("a\0\0\0", 4)));
    String appendedTo(make<String>("abcd").c_str());
    appendedTo[1] = Char();
    appendedTo.add(TestFixture::letters(N).c_str());
    EXPECT_EQ(contentOf(appendedTo), make<String>(std::string_view("a\0\0\0", 4)) + TestFixture::letters(N));
    String fits(make<String>("abcd").c_str());
    fits[1] = Char();
    fits.add(make<String>("e").c_str());
    EXPECT_EQ(contentOf(fits), make<String>(std::string_view("a\0cde", 5)))
        << "nothing is copied while the capacity suffices";
}

TYPED_TEST(InlineTextArea, Kept_text_07_a_string_never_leaves_the_heap) {
    using String = TypeParam;
    using Char = CharOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s(TestFixture::letters(N + 10).c_str());
    Char const* block = s;
    s.clear();
    EXPECT_EQ(static_cast<Char const*>(s), block);
    EXPECT_EQ(s.sizeBuf(), N + 11);
    s = make<String>("a").c_str();
    s.cut();
    s.cut(0);
    s = String();
    s.copy(nullptr);
    s.resize();
    s.replace(0, 5, make<String>("").c_str());
    EXPECT_EQ(static_cast<Char const*>(s), block);
    EXPECT_EQ(s.sizeBuf(), N + 11);
    EXPECT_EQ(s.size(), 0U);
    s.copy(TestFixture::letters(N + 10).c_str());
    EXPECT_EQ(static_cast<Char const*>(s), block) << "the same length fits again";
}

TYPED_TEST(InlineTextArea, Kept_text_08_growth_is_exact) {
    using String = TypeParam;
    using Char = CharOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s = TestFixture::appended(N);
    for (std::uint64_t size = N + 1; size < N + 40; ++size) {
        s += Char('x');
        ASSERT_EQ(s.sizeBuf(), size);
        ASSERT_EQ(s.size(), size);
    }
}

TYPED_TEST(InlineTextArea, the_capacity_check_asks_for_the_larger_of_need_and_keep_plus_one) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    struct Case {
        Row row;
        std::uint64_t need;
        std::uint64_t keep;
        std::uint64_t capacity;
    };
    for (Case const& c : {Case{{}, N, N - 1, N}, Case{{}, N, N, N + 1}, Case{{}, N + 1, 3, N + 1}, Case{{}, 0, 0, N},
                          Case{{}, 0, N + 7, N + 8}, Case{{}, N + 9, N + 8, N + 9}, Case{{}, N + 9, N + 9, N + 10}}) {
        SCOPED_TRACE(c.row);
        Text const source = TestFixture::letters(N + 20);
        OpenedText<String> s;
        s.add(make<String>("xy").c_str());
        bool const moved = s.CopyIfTooLong(source.c_str(), c.need, c.keep);
        EXPECT_EQ(moved, c.capacity != N);
        EXPECT_EQ(s.sizeBuf(), c.capacity);
        EXPECT_EQ(s.size(), 2U) << "the size is the caller's business";
        Text const held(static_cast<Char const*>(s));
        EXPECT_EQ(held, moved ? TestFixture::letters(c.keep) : make<String>("xy"));
    }
}

TYPED_TEST(InlineTextArea, extends_to_what_is_asked_for_and_to_its_size_plus_one) {
    using String = TypeParam;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s(make<String>("abc").c_str());
    s.extendBuf(N);
    EXPECT_TRUE(isInside(s));
    s.extendBuf(N + 5);
    EXPECT_EQ(s.sizeBuf(), N + 5);
    EXPECT_EQ(contentOf(s), make<String>("abc"));
    s.extendBuf(N + 4);
    EXPECT_EQ(s.sizeBuf(), N + 5);
    String full = TestFixture::appended(N);
    full.extendBuf(0);
    EXPECT_EQ(full.sizeBuf(), N + 1) << "a full string always grows";
    EXPECT_EQ(contentOf(full), TestFixture::letters(N));
}

TYPED_TEST(InlineTextArea, measures_after_direct_writes) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (bool heap : {false, true}) {
        String s;
        if (heap) s.extendBuf(N + 10);
        Text const written = make<String>(std::string_view("abc\0def", 8));
        std::copy(written.begin(), written.end(), s.getBuf());
        s.resize();
        EXPECT_EQ(contentOf(s), make<String>("abc"));
        s.getBuf()[3] = Char('-');
        s.resize(0);
        EXPECT_EQ(contentOf(s), make<String>("abc-def"));
        s.resize(5);
        EXPECT_EQ(contentOf(s), make<String>("abc-d"));
        EXPECT_TRUE(isTerminated(s));
        s.resize(100);
        EXPECT_EQ(contentOf(s), make<String>("abc-d"));
    }
}

TYPED_TEST(InlineTextArea, Kept_text_10_a_terminator_is_stored_at_the_index_of_the_capacity) {
    using String = TypeParam;
    using Char = CharOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (bool heap : {false, true}) {
        String s;
        if (heap) s.extendBuf(N + 10);
        std::uint64_t const capacity = s.sizeBuf();
        std::fill_n(s.getBuf(), capacity + 1, Char('x'));
        s.resize();
        EXPECT_EQ(s.size(), capacity);
        EXPECT_TRUE(isTerminated(s));
        std::fill_n(s.getBuf(), capacity + 1, Char('y'));
        s.resize(3);
        EXPECT_EQ(contentOf(s), make<String>("yyy"));
        EXPECT_EQ(s.getBuf()[capacity], Char()) << "there too, when the text is cut further";
        std::fill_n(s.getBuf(), capacity + 1, Char('z'));
        s.resize(capacity + 100);
        EXPECT_EQ(s.size(), capacity);
    }
}
