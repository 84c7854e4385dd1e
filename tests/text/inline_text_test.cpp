// What BufStr<15>, BufStr<255> and WBStr have in common, one suite over all three.

#include "tests/support/table.h"
#include "tests/text/string_kinds.h"

#include <gtest/gtest.h>

#include <limits>
#include <type_traits>
#include <unordered_set>
#include <utility>

using namespace ZOR_Basis;

static_assert(sizeof(BufStr<15>) == 32 && sizeof(BufStr<255>) == 272 && sizeof(WBStr) == 536);
static_assert(!std::is_polymorphic_v<BufStr<15>> && std::is_polymorphic_v<WBStr>);
static_assert(!std::has_virtual_destructor_v<WBStr>);

namespace {

template <class String>
class InlineString : public testing::Test {
public:
    static TextOf<String> letters(std::uint64_t n) {
        TextOf<String> text;
        for (std::uint64_t i = 0; i < n; ++i) text += static_cast<typename Kind<String>::Char>('a' + i % 26);
        return text;
    }
    static String appended(std::uint64_t n) {
        String s;
        for (auto c : letters(n)) s += c;
        return s;
    }
    static String onHeap(TextOf<String> const& text) {
        String s;
        s.extendBuf(Kind<String>::Inside + 1);
        s.copy(text.c_str());
        return s;
    }
};

#if defined(__GNUC__)
#pragma GCC diagnostic ignored "-Wnon-virtual-dtor" // as WBStr itself, never deleted through a base
#endif

template <class String>
struct Opened : String {
    using String::CopyIfTooLong;
    using String::String;
};

struct KindNames {
    template <class String>
    static std::string GetName(int) {
        if (std::is_same_v<String, WBStr>) return "WBStr";
        return "BufStr" + std::to_string(Kind<String>::Inside);
    }
};

} // namespace

using Kinds = testing::Types<BufStr<15>, BufStr<255>, WBStr>;
TYPED_TEST_SUITE(InlineString, Kinds, KindNames);

#define USE_KIND                                                                                                       \
    using String = TypeParam;                                                                                          \
    using Char [[maybe_unused]] = typename Kind<String>::Char;                                                         \
    using View [[maybe_unused]] = typename Kind<String>::View;                                                         \
    using Text [[maybe_unused]] = TextOf<String>;                                                                      \
    [[maybe_unused]] constexpr std::uint64_t N = Kind<String>::Inside;                                                 \
    [[maybe_unused]] auto const text = [](std::string_view ascii) { return make<String>(ascii); };                     \
    [[maybe_unused]] auto const letters = [](std::uint64_t n) { return InlineString<String>::letters(n); }

TYPED_TEST(InlineString, breathes) {
    USE_KIND;
    String s(text("tray").c_str());
    s += Char('1');
    EXPECT_EQ(contentOf(s), text("tray1"));
    EXPECT_TRUE(isInside(s));
    s.add(letters(N).c_str());
    EXPECT_FALSE(isInside(s));
    EXPECT_EQ(s.size(), 5 + N);
}

TYPED_TEST(InlineString, begins_empty_and_inside) {
    USE_KIND;
    String const s;
    EXPECT_TRUE(isInside(s) && isTerminated(s));
    EXPECT_EQ(s.size(), 0U);
    EXPECT_EQ(s.sizeBuf(), N);
}

TYPED_TEST(InlineString, makes_copies_of_every_kind_of_source) {
    USE_KIND;
    Text const source = text("abc");
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
          Case{{}, String(View(nullptr, 5)), ""}, Case{{}, String(text("").c_str(), 5), ""},
          Case{{}, String(text(std::string_view("\0ab", 3)).c_str(), 3), ""}, Case{{}, String(View()), ""}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(contentOf(c.made), text(c.expected));
        EXPECT_TRUE(isInside(c.made) && isTerminated(c.made));
    }
}

TYPED_TEST(InlineString, a_copy_is_independent_and_begins_inside) {
    USE_KIND;
    String const source = TestFixture::onHeap(text("abc"));
    ASSERT_FALSE(isInside(source));
    String copy(source);
    EXPECT_TRUE(isInside(copy)) << "short text goes inside, wherever it came from";
    copy[0] = Char('x');
    EXPECT_EQ(contentOf(source), text("abc"));
    String moved(std::move(copy));
    EXPECT_EQ(contentOf(moved), text("xbc"));
    EXPECT_EQ(contentOf(copy), text("xbc")) << "a move copies"; // NOLINT(bugprone-use-after-move)
}

TYPED_TEST(InlineString, Kept_text_04_assigning_needs_one_unit_more_than_the_text) {
    USE_KIND;
    for (bool given : {false, true}) {
        auto const length = [given](std::uint64_t n) { return given ? n : 0; };
        String const fits(letters(N - 1).c_str(), length(N - 1));
        EXPECT_TRUE(isInside(fits));
        EXPECT_EQ(fits.sizeBuf(), N);
        String const spills(letters(N).c_str(), length(N));
        EXPECT_FALSE(isInside(spills));
        EXPECT_EQ(spills.sizeBuf(), N + 1);
        EXPECT_EQ(contentOf(spills), letters(N));
        String grown;
        grown.copy(letters(N + 5).c_str(), length(N + 5));
        EXPECT_EQ(grown.sizeBuf(), N + 6);
        grown.copy(letters(N + 6).c_str(), length(N + 6));
        EXPECT_EQ(grown.sizeBuf(), N + 7) << "a block is outgrown in the same way";
    }
    String const inside = TestFixture::appended(N);
    ASSERT_TRUE(isInside(inside));
    String const copy(inside);
    EXPECT_FALSE(isInside(copy)) << "even a copy of an inside text";
    EXPECT_EQ(copy.sizeBuf(), N + 1);
}

TYPED_TEST(InlineString, Kept_text_05_appending_fills_the_area_to_its_last_unit) {
    USE_KIND;
    String s = TestFixture::appended(N);
    EXPECT_TRUE(isInside(s) && isTerminated(s));
    EXPECT_EQ(s.sizeBuf(), N);
    EXPECT_EQ(contentOf(s), letters(N));
    s += Char('!');
    EXPECT_FALSE(isInside(s));
    EXPECT_EQ(s.sizeBuf(), N + 1);
    EXPECT_EQ(contentOf(s), letters(N) + Char('!'));
    String whole;
    whole.add(letters(N).c_str());
    EXPECT_TRUE(isInside(whole));
    String given;
    given.add(letters(N).c_str(), N);
    EXPECT_TRUE(isInside(given));
    given.add(letters(1).c_str(), 1);
    EXPECT_EQ(given.sizeBuf(), N + 1);
}

TYPED_TEST(InlineString, Kept_text_06_a_given_length_stays_the_size_and_zeros_follow_the_terminator) {
    USE_KIND;
    for (std::uint64_t claimed : {std::uint64_t{4}, std::uint64_t{10}, N - 1, N, N + 20}) {
        Exact<Char> const source(text("abc"));
        Text expected = text("abc");
        expected.resize(claimed);
        String const made(source, claimed);
        EXPECT_EQ(contentOf(made), expected);
        String copied = TestFixture::appended(N);
        copied.copy(source, claimed);
        EXPECT_EQ(contentOf(copied), expected);
        String added(text("x").c_str());
        added.add(source, claimed);
        EXPECT_EQ(contentOf(added), Char('x') + expected);
        added.add(text("y").c_str());
        EXPECT_EQ(contentOf(added).front(), Char('x'));
        String inserted(text("[]").c_str());
        inserted.insert(1, source, claimed);
        EXPECT_EQ(contentOf(inserted), Char('[') + expected + Char(']'));
        String replaced(text("[--]").c_str());
        replaced.replace(1, 2, View(source, claimed));
        EXPECT_EQ(contentOf(replaced), Char('[') + expected + Char(']'));
        EXPECT_TRUE(isTerminated(made) && isTerminated(copied) && isTerminated(added) && isTerminated(inserted));
    }
    Text const zeroInside = text(std::string_view("ab\0cd", 5));
    EXPECT_EQ(contentOf(String(zeroInside.c_str(), 5)), text(std::string_view("ab\0\0\0", 5)));
    EXPECT_EQ(contentOf(String(View(zeroInside.c_str(), 5))), text(std::string_view("ab\0\0\0", 5)));
}

TYPED_TEST(InlineString, Kept_text_06_the_rule_holds_wherever_the_zero_lies) {
    USE_KIND;
    for (std::uint64_t size :
         {1U, 2U, 3U, 4U, 7U, 8U, 9U, 14U, 15U, 16U, 17U, 31U, 32U, 33U, 63U, 64U, 65U, 127U, 200U, 254U, 255U, 300U}) {
        for (std::uint64_t zero = 1; zero < size; ++zero) {
            String source = TestFixture::appended(size);
            source[zero] = Char();
            Text expected = letters(size);
            expected.resize(zero);
            expected.resize(size);
            String const copy(source);
            ASSERT_EQ(contentOf(copy), expected) << size << ' ' << zero;
            String assigned(text("?").c_str());
            assigned = source;
            ASSERT_EQ(contentOf(assigned), expected) << size << ' ' << zero;
            String const view(View(source, size));
            ASSERT_EQ(contentOf(view), expected) << size << ' ' << zero;
            Text const exact = letters(zero);
            ASSERT_EQ(contentOf(String(Exact<Char>(exact), size)), expected) << size << ' ' << zero;
        }
    }
}

TYPED_TEST(InlineString, a_growing_string_keeps_its_text_up_to_an_inner_zero) {
    USE_KIND;
    String s(text("abcd").c_str());
    s[1] = Char();
    s.extendBuf(N + 1);
    EXPECT_EQ(contentOf(s), text(std::string_view("a\0\0\0", 4)));
    String appendedTo(text("abcd").c_str());
    appendedTo[1] = Char();
    appendedTo.add(letters(N).c_str());
    EXPECT_EQ(contentOf(appendedTo), text(std::string_view("a\0\0\0", 4)) + letters(N));
    String fits(text("abcd").c_str());
    fits[1] = Char();
    fits.add(text("e").c_str());
    EXPECT_EQ(contentOf(fits), text(std::string_view("a\0cde", 5))) << "nothing is copied while the capacity lasts";
}

TYPED_TEST(InlineString, Kept_text_07_a_string_never_leaves_the_heap) {
    USE_KIND;
    String s(letters(N + 10).c_str());
    Char const* block = s;
    s.clear();
    EXPECT_EQ(static_cast<Char const*>(s), block);
    EXPECT_EQ(s.sizeBuf(), N + 11);
    s = text("a").c_str();
    s.cut();
    s.cut(0);
    s = String();
    s.copy(nullptr);
    s.resize();
    s.replace(0, 5, text("").c_str());
    EXPECT_EQ(static_cast<Char const*>(s), block);
    EXPECT_EQ(s.sizeBuf(), N + 11);
    EXPECT_EQ(s.size(), 0U);
    s.copy(letters(N + 10).c_str());
    EXPECT_EQ(static_cast<Char const*>(s), block) << "the same length fits again";
}

TYPED_TEST(InlineString, Kept_text_08_growth_is_exact) {
    USE_KIND;
    String s = TestFixture::appended(N);
    for (std::uint64_t size = N + 1; size < N + 40; ++size) {
        s += Char('x');
        ASSERT_EQ(s.sizeBuf(), size);
        ASSERT_EQ(s.size(), size);
    }
}

TYPED_TEST(InlineString, the_capacity_check_asks_for_the_larger_of_need_and_keep_plus_one) {
    USE_KIND;
    struct Case {
        Row row;
        std::uint64_t need;
        std::uint64_t keep;
        std::uint64_t capacity;
    };
    for (Case const& c : {Case{{}, N, N - 1, N}, Case{{}, N, N, N + 1}, Case{{}, N + 1, 3, N + 1}, Case{{}, 0, 0, N},
                          Case{{}, 0, N + 7, N + 8}, Case{{}, N + 9, N + 8, N + 9}, Case{{}, N + 9, N + 9, N + 10}}) {
        SCOPED_TRACE(c.row);
        Text const source = letters(N + 20);
        Opened<String> s;
        s.add(text("xy").c_str());
        bool const moved = s.CopyIfTooLong(source.c_str(), c.need, c.keep);
        EXPECT_EQ(moved, c.capacity != N);
        EXPECT_EQ(s.sizeBuf(), c.capacity);
        EXPECT_EQ(s.size(), 2U) << "the size is the caller's business";
        Text const held(static_cast<Char const*>(s));
        EXPECT_EQ(held, moved ? letters(c.keep) : text("xy"));
    }
}

TYPED_TEST(InlineString, extends_to_what_is_asked_for_and_to_its_size_plus_one) {
    USE_KIND;
    String s(text("abc").c_str());
    s.extendBuf(N);
    EXPECT_TRUE(isInside(s));
    s.extendBuf(N + 5);
    EXPECT_EQ(s.sizeBuf(), N + 5);
    EXPECT_EQ(contentOf(s), text("abc"));
    s.extendBuf(N + 4);
    EXPECT_EQ(s.sizeBuf(), N + 5);
    String full = TestFixture::appended(N);
    full.extendBuf(0);
    EXPECT_EQ(full.sizeBuf(), N + 1) << "a full string always grows";
    EXPECT_EQ(contentOf(full), letters(N));
}

TYPED_TEST(InlineString, assigns_every_kind_of_source) {
    USE_KIND;
    String s(text("old").c_str());
    Text const source = text("abcdef");
    s = source.c_str();
    EXPECT_EQ(contentOf(s), text("abcdef"));
    s = View(source.c_str(), 2);
    EXPECT_EQ(contentOf(s), text("ab"));
    s = View(source.c_str(), 0);
    EXPECT_EQ(contentOf(s), text("abcdef"));
    s = String(text("xyz").c_str());
    EXPECT_EQ(contentOf(s), text("xyz"));
    EXPECT_EQ(&s.copy(source.c_str(), 3), &s);
    EXPECT_EQ(contentOf(s), text("abc"));
    s = nullptr;
    EXPECT_EQ(s.size(), 0U);
    s = source.c_str();
    s = text("").c_str();
    EXPECT_EQ(s.size(), 0U);
    s = source.c_str();
    EXPECT_EQ(&s.copy(nullptr, 3), &s);
    EXPECT_EQ(s.size(), 0U);
    EXPECT_TRUE(isTerminated(s));
}

TYPED_TEST(InlineString, assigning_itself_or_its_own_text_changes_nothing) {
    USE_KIND;
    String s = TestFixture::appended(N);
    s[1] = Char();
    Text const before = contentOf(s);
    String const& same = s;
    s = same;
    s = static_cast<View const&>(same);
    s = static_cast<Char const*>(same);
    EXPECT_EQ(contentOf(s), before);
    EXPECT_TRUE(isInside(s)) << "although assigning as many units of another text would move it";
}

TYPED_TEST(InlineString, assigns_parts_of_its_own_text) {
    USE_KIND;
    for (bool heap : {false, true}) {
        auto const start = [&] {
            return heap ? TestFixture::onHeap(text("0123456789")) : String(text("0123456789").c_str());
        };
        String s = start();
        s = static_cast<Char const*>(s) + 3;
        EXPECT_EQ(contentOf(s), text("3456789"));
        s = start();
        s = View(static_cast<Char const*>(s), 4);
        EXPECT_EQ(contentOf(s), text("0123")) << "a view of the text is not the string itself";
        s = start();
        s.copy(static_cast<Char const*>(s) + 2, 3);
        EXPECT_EQ(contentOf(s), text("234"));
        s = start();
        s.copy(static_cast<Char const*>(s) + 8, N + 30);
        Text expected = text("89");
        expected.resize(N + 30);
        EXPECT_EQ(contentOf(s), expected);
        s = start();
        s.copy(static_cast<Char const*>(s) + 8, 12);
        expected.resize(12);
        EXPECT_EQ(contentOf(s), expected);
    }
}

TYPED_TEST(InlineString, appends_every_kind_of_source) {
    USE_KIND;
    Text const source = text("abc");
    String s;
    EXPECT_EQ(&s.add(source.c_str()), &s);
    EXPECT_EQ(&s.add(source.c_str(), 2), &s);
    EXPECT_EQ(&s.add(View(source.c_str(), 1)), &s);
    EXPECT_EQ(&(s += View(source.c_str(), 0)), &s);
    EXPECT_EQ(&(s += source.c_str()), &s);
    EXPECT_EQ(contentOf(s), text("abcabaabcabc"));
    for (String* result : {&s.add(nullptr), &s.add(nullptr, 4), &s.add(text("").c_str(), 4), &(s += View()),
                           &(s += text("").c_str()), &(s += View(nullptr, 3))}) {
        EXPECT_EQ(result, &s);
    }
    EXPECT_EQ(contentOf(s), text("abcabaabcabc"));
}

TYPED_TEST(InlineString, Kept_text_09_a_zero_unit_appends_nothing) {
    USE_KIND;
    String s(text("ab").c_str());
    s += Char();
    s += 0;
    s += 0L;
    EXPECT_EQ(contentOf(s), text("ab"));
    s += 99;
    EXPECT_EQ(contentOf(s), text("abc"));
    String full = TestFixture::appended(N);
    full += Char();
    EXPECT_TRUE(isInside(full));
}

TYPED_TEST(InlineString, appends_parts_of_its_own_text) {
    USE_KIND;
    for (std::uint64_t size : {std::uint64_t{3}, N / 2, N - 1, N, N + 7}) {
        Text const before = letters(size);
        String s = TestFixture::appended(size);
        s.add(s);
        EXPECT_EQ(contentOf(s), before + before) << size;
        s = TestFixture::appended(size);
        s += static_cast<Char const*>(s) + 1;
        EXPECT_EQ(contentOf(s), before + before.substr(1)) << size;
        s = TestFixture::appended(size);
        s.add(static_cast<Char const*>(s) + 2, 1);
        EXPECT_EQ(contentOf(s), before + before.substr(2, 1)) << size;
        s = TestFixture::appended(size);
        s.add(static_cast<Char const*>(s) + 1, size + 5);
        Text expected = before.substr(1);
        expected.resize(size + 5);
        EXPECT_EQ(contentOf(s), before + expected) << size;
    }
    String behindZero = TestFixture::appended(N);
    behindZero[2] = Char();
    Text const tail = letters(N).substr(3);
    behindZero += static_cast<Char const*>(behindZero) + 3;
    EXPECT_EQ(contentOf(behindZero).substr(N), tail) << "what the growing drops has been read before";
}

TYPED_TEST(InlineString, inserts) {
    USE_KIND;
    struct Case {
        Row row;
        char const* before;
        std::uint64_t position;
        char const* source;
        std::uint64_t length;
        char const* after;
    };
    for (Case const& c :
         {Case{{}, "ad", 1, "bc", 0, "abcd"}, Case{{}, "cd", 0, "ab", 0, "abcd"}, Case{{}, "ab", 2, "cd", 0, "abcd"},
          Case{{}, "ab", 3, "cd", 0, "ab"}, Case{{}, "ad", 1, "bcx", 2, "abcd"}, Case{{}, "ab", 1, "", 3, "ab"},
          Case{{}, "ab", 1, nullptr, 3, "ab"}, Case{{}, "", 0, "ab", 0, "ab"}, Case{{}, "", 1, "ab", 0, ""},
          Case{{}, "ab", std::numeric_limits<std::uint64_t>::max(), "x", 0, "ab"}}) {
        SCOPED_TRACE(c.row);
        for (bool heap : {false, true}) {
            String s(text(c.before).c_str());
            if (heap) s.extendBuf(N + 3);
            Text const source = text(c.source != nullptr ? c.source : "");
            String& result = s.insert(c.position, c.source != nullptr ? source.c_str() : nullptr, c.length);
            EXPECT_EQ(&result, &s);
            EXPECT_EQ(contentOf(s), text(c.after));
            EXPECT_TRUE(isTerminated(s));
            EXPECT_EQ(s.sizeBuf(), heap ? N + 3 : N);
        }
    }
    String viewed(text("ad").c_str());
    viewed.insert(1, View(text("bcx").c_str(), 2));
    EXPECT_EQ(contentOf(viewed), text("abcd"));
}

TYPED_TEST(InlineString, inserting_fills_the_capacity_and_grows_exactly) {
    USE_KIND;
    String s = TestFixture::appended(N - 1);
    s.insert(1, text("!").c_str());
    EXPECT_TRUE(isInside(s));
    EXPECT_EQ(s.size(), N);
    s.insert(1, text("?").c_str());
    EXPECT_EQ(s.sizeBuf(), N + 1);
    EXPECT_EQ(contentOf(s), text("a?!") + letters(N - 1).substr(1));
    s.insert(0, text("12").c_str());
    EXPECT_EQ(s.sizeBuf(), N + 3);
    EXPECT_EQ(contentOf(s), text("12a?!") + letters(N - 1).substr(1));
}

TYPED_TEST(InlineString, replaces) {
    USE_KIND;
    struct Case {
        Row row;
        char const* before;
        std::uint64_t position;
        std::uint64_t count;
        char const* source;
        std::uint64_t length;
        char const* after;
    };
    std::uint64_t const all = std::numeric_limits<std::uint64_t>::max();
    for (Case const& c : {Case{{}, "abcd", 1, 2, "xy", 0, "axyd"}, Case{{}, "abcd", 1, 2, "x", 0, "axd"},
                          Case{{}, "abcd", 1, 2, "xyz", 0, "axyzd"}, Case{{}, "abcd", 1, 2, "", 0, "ad"},
                          Case{{}, "abcd", 1, 2, nullptr, 9, "ad"}, Case{{}, "abcd", 1, all, "x", 0, "ax"},
                          Case{{}, "abcd", 1, 0, "x", 0, "axbcd"}, Case{{}, "abcd", 4, 2, "x", 0, "abcdx"},
                          Case{{}, "abcd", 5, 2, "x", 0, "abcd"}, Case{{}, "abcd", 0, 4, "xyz", 2, "xy"},
                          Case{{}, "abcd", 0, 9, "", 0, ""}, Case{{}, "", 0, 0, "x", 0, "x"}}) {
        SCOPED_TRACE(c.row);
        for (bool heap : {false, true}) {
            String s(text(c.before).c_str());
            if (heap) s.extendBuf(N + 3);
            Text const source = text(c.source != nullptr ? c.source : "");
            EXPECT_EQ(&s.replace(c.position, c.count, c.source != nullptr ? source.c_str() : nullptr, c.length), &s);
            EXPECT_EQ(contentOf(s), text(c.after));
            EXPECT_TRUE(isTerminated(s));
            EXPECT_EQ(s.sizeBuf(), heap ? N + 3 : N);
        }
    }
}

TYPED_TEST(InlineString, replacing_grows_exactly) {
    USE_KIND;
    String s = TestFixture::appended(N);
    s.replace(2, 3, text("xyz").c_str());
    EXPECT_TRUE(isInside(s));
    s.replace(2, 3, text("123456").c_str());
    EXPECT_EQ(s.sizeBuf(), N + 3);
    EXPECT_EQ(contentOf(s), text("ab123456") + letters(N).substr(5));
}

TYPED_TEST(InlineString, inserting_and_replacing_move_the_rest_with_its_zeros) {
    USE_KIND;
    for (std::uint64_t length : {std::uint64_t{1}, N}) {
        String s(text("abcdef").c_str());
        s[1] = Char();
        s[4] = Char();
        s.insert(3, letters(length).c_str());
        EXPECT_EQ(contentOf(s),
                  text(std::string_view("a\0c", 3)) + letters(length) + text(std::string_view("d\0f", 3)));
        s.replace(3, length, letters(2 * length).c_str());
        EXPECT_EQ(contentOf(s),
                  text(std::string_view("a\0c", 3)) + letters(2 * length) + text(std::string_view("d\0f", 3)));
    }
}

TYPED_TEST(InlineString, inserts_and_replaces_with_parts_of_its_own_text) {
    USE_KIND;
    for (std::uint64_t size : {std::uint64_t{6}, N / 2, N / 2 + 1, N - 1, N + 7}) {
        Text const before = letters(size);
        for (std::uint64_t from : {std::uint64_t{0}, std::uint64_t{1}, std::uint64_t{4}, size - 1}) {
            for (std::uint64_t length : {std::uint64_t{0}, std::uint64_t{1}, std::uint64_t{3}, size + 9}) {
                Text source = before.substr(from, length != 0 ? length : Text::npos);
                if (length != 0) source.resize(length);
                String s = TestFixture::appended(size);
                s.insert(2, static_cast<Char const*>(s) + from, length);
                Text expected = before;
                ASSERT_EQ(contentOf(s), expected.insert(2, source)) << size << ' ' << from << ' ' << length;
                s = TestFixture::appended(size);
                s.replace(1, 2, static_cast<Char const*>(s) + from, length);
                expected = before;
                ASSERT_EQ(contentOf(s), expected.replace(1, 2, source)) << size << ' ' << from << ' ' << length;
            }
        }
    }
}

TYPED_TEST(InlineString, cuts) {
    USE_KIND;
    String s(text("abcd").c_str());
    s.cut();
    EXPECT_EQ(contentOf(s), text("abc"));
    s.cut(3);
    s.cut(100);
    EXPECT_EQ(contentOf(s), text("abc"));
    s.cut(1);
    EXPECT_EQ(contentOf(s), text("a"));
    s.cut(0);
    s.cut();
    s.cut();
    EXPECT_EQ(s.size(), 0U);
    EXPECT_TRUE(isTerminated(s));
    s = text("abcd").c_str();
    s.getBuf()[4] = Char('x');
    s.cut(4);
    EXPECT_TRUE(isTerminated(s)) << "a cut behind the end only terminates again";
    s.cut();
    EXPECT_TRUE(isTerminated(s));
}

TYPED_TEST(InlineString, measures_after_direct_writes) {
    USE_KIND;
    for (bool heap : {false, true}) {
        String s;
        if (heap) s.extendBuf(N + 10);
        Text const written = text(std::string_view("abc\0def", 8));
        std::copy(written.begin(), written.end(), s.getBuf());
        s.resize();
        EXPECT_EQ(contentOf(s), text("abc"));
        s.getBuf()[3] = Char('-');
        s.resize(0);
        EXPECT_EQ(contentOf(s), text("abc-def"));
        s.resize(5);
        EXPECT_EQ(contentOf(s), text("abc-d"));
        EXPECT_TRUE(isTerminated(s));
        s.resize(100);
        EXPECT_EQ(contentOf(s), text("abc-d"));
    }
}

TYPED_TEST(InlineString, Kept_text_10_a_terminator_is_stored_at_the_index_of_the_capacity) {
    USE_KIND;
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
        EXPECT_EQ(contentOf(s), text("yyy"));
        EXPECT_EQ(s.getBuf()[capacity], Char()) << "there too, when the text is cut further";
        std::fill_n(s.getBuf(), capacity + 1, Char('z'));
        s.resize(capacity + 100);
        EXPECT_EQ(s.size(), capacity);
    }
}

TYPED_TEST(InlineString, gives_units_by_index) {
    USE_KIND;
    enum Place { Second = 1 };
    String s(text("abc").c_str());
    s[0] = Char('x');
    s[1U] = Char('y');
    s[static_cast<short>(2)] = Char('z');
    EXPECT_EQ(contentOf(s), text("xyz"));
    String const& view = s;
    EXPECT_EQ(view[0], Char('x'));
    EXPECT_EQ(view[Second], Char('y'));
    s.getBuf()[3] = Char('!');
    EXPECT_EQ(view[3], Char()) << "at the size there is a zero, whatever lies there";
    EXPECT_EQ(view[4L], Char());
    EXPECT_EQ(view[std::numeric_limits<std::uint64_t>::max()], Char());
    EXPECT_EQ(view[-1], Char());
}

TYPED_TEST(InlineString, counts_in_letters) {
    USE_KIND;
    struct Case {
        Row row;
        char const* before;
        char const* after;
    };
    for (Case const& c : {Case{{}, "", "a"}, Case{{}, "a", "b"}, Case{{}, "y", "z"}, Case{{}, "z", "aa"},
                          Case{{}, "az", "ba"}, Case{{}, "zz", "aaa"}, Case{{}, "abz", "aca"}, Case{{}, "zy", "zz"}}) {
        SCOPED_TRACE(c.row);
        String s(text(c.before).c_str());
        s.NextLatin();
        EXPECT_EQ(contentOf(s), text(c.after));
        EXPECT_TRUE(isTerminated(s));
    }
    String counter;
    for (int i = 0; i < 26 + 26 * 26; ++i) counter.NextLatin();
    EXPECT_EQ(contentOf(counter), text("zz"));
    String full;
    for (std::uint64_t i = 0; i < N; ++i) full += Char('z');
    full.NextLatin();
    EXPECT_EQ(full.sizeBuf(), N + 1) << "the new letter is appended";
    EXPECT_EQ(contentOf(full), Text(N + 1, Char('a')));
}

TYPED_TEST(InlineString, counts_from_a_place_leftwards) {
    USE_KIND;
    String s(text("azzq").c_str());
    String::NextLatin(s, 2);
    EXPECT_EQ(contentOf(s), text("baaq"));
    String::NextLatin(s, 0);
    EXPECT_EQ(contentOf(s), text("caaq"));
    String::NextLatin(s, 4);
    EXPECT_EQ(contentOf(s), text("caaq")) << "behind the end nothing happens";
    String zs(text("zzq").c_str());
    String::NextLatin(zs, 1);
    EXPECT_EQ(contentOf(zs), text("aaqa"));
    String empty;
    String::NextLatin(empty, 0);
    EXPECT_EQ(contentOf(empty), text("a"));
}

TYPED_TEST(InlineString, Kept_text_12_whatever_is_no_z_is_incremented) {
    USE_KIND;
    struct Case {
        Row row;
        char const* before;
        char const* after;
    };
    for (Case const& c : {Case{{}, "Z", "["}, Case{{}, "A9", "A:"}, Case{{}, "9z", ":a"}, Case{{}, "-zz", ".aa"}}) {
        SCOPED_TRACE(c.row);
        String s(text(c.before).c_str());
        s.NextLatin();
        EXPECT_EQ(contentOf(s), text(c.after));
    }
}

TYPED_TEST(InlineString, is_a_key_of_hashed_containers) {
    USE_KIND;
    std::hash<String> const hash;
    EXPECT_EQ(hash(String(text("abc").c_str())), hash(TestFixture::onHeap(text("abc"))));
    EXPECT_NE(hash(String(text("abc").c_str())), hash(String(text("abd").c_str())));
    String a(text("ab-d").c_str());
    String b(text("ab-e").c_str());
    EXPECT_NE(hash(a), hash(b));
    a[2] = Char();
    b[2] = Char();
    EXPECT_TRUE(a == b);
    EXPECT_EQ(hash(a), hash(b)) << "what is equal up to an inner zero hashes to the same value";
    std::unordered_set<String> const set{String(text("x").c_str()), String(text("x").c_str())};
    EXPECT_EQ(set.size(), 1U);
}
