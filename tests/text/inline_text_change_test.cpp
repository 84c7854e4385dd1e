// Appending, inserting, replacing and cutting in BufStr<15>, BufStr<255> and WBStr.

#include "tests/support/table.h"
#include "tests/text/inline_text_suite.h"

#include <gtest/gtest.h>

#include <limits>
#include <string_view>

using namespace ZOR_Basis;

namespace {

template <class String>
class InlineTextChange : public InlineTextSuite<String> {};
TYPED_TEST_SUITE(InlineTextChange, InlineTextKinds, InlineTextNames);

} // namespace

TYPED_TEST(InlineTextChange, appends_every_kind_of_source) {
    using String = TypeParam;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    Text const source = make<String>("abc");
    String s;
    EXPECT_EQ(&s.add(source.c_str()), &s);
    EXPECT_EQ(&s.add(source.c_str(), 2), &s);
    EXPECT_EQ(&s.add(View(source.c_str(), 1)), &s);
    EXPECT_EQ(&(s += View(source.c_str(), 0)), &s);
    EXPECT_EQ(&(s += source.c_str()), &s);
    EXPECT_EQ(contentOf(s), make<String>("abcabaabcabc"));
    for (String* result : {&s.add(nullptr), &s.add(nullptr, 4), &s.add(make<String>("").c_str(), 4), &(s += View()),
                           &(s += make<String>("").c_str()), &(s += View(nullptr, 3))}) {
        EXPECT_EQ(result, &s);
    }
    EXPECT_EQ(contentOf(s), make<String>("abcabaabcabc"));
}

TYPED_TEST(InlineTextChange, Kept_text_09_a_zero_unit_appends_nothing) {
    using String = TypeParam;
    using Char = CharOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s(make<String>("ab").c_str());
    s += Char();
    s += 0;
    s += 0L;
    EXPECT_EQ(contentOf(s), make<String>("ab"));
    s += 99;
    EXPECT_EQ(contentOf(s), make<String>("abc"));
    String full = TestFixture::appended(N);
    full += Char();
    EXPECT_TRUE(isInside(full));
}

TYPED_TEST(InlineTextChange, appends_parts_of_its_own_text) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (std::uint64_t size : {std::uint64_t{3}, N / 2, N - 1, N, N + 7}) {
        Text const before = TestFixture::letters(size);
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
    Text const tail = TestFixture::letters(N).substr(3);
    behindZero += static_cast<Char const*>(behindZero) + 3;
    EXPECT_EQ(contentOf(behindZero).substr(N), tail) << "the source is read before growing drops it";
}

namespace {

struct Insertion {
    Row row;
    char const* before;
    std::uint64_t position;
    char const* source;
    std::uint64_t length;
    char const* after;
};

constexpr std::uint64_t FAR = std::numeric_limits<std::uint64_t>::max();

Insertion const INSERTIONS[] = {{{}, "ad", 1, "bc", 0, "abcd"},  {{}, "cd", 0, "ab", 0, "abcd"},
                                {{}, "ab", 2, "cd", 0, "abcd"},  {{}, "ab", 3, "cd", 0, "ab"},
                                {{}, "ad", 1, "bcx", 2, "abcd"}, {{}, "ab", 1, "", 3, "ab"},
                                {{}, "ab", 1, nullptr, 3, "ab"}, {{}, "", 0, "ab", 0, "ab"},
                                {{}, "", 1, "ab", 0, ""},        {{}, "ab", FAR, "x", 0, "ab"}};

} // namespace

TYPED_TEST(InlineTextChange, inserts) {
    using String = TypeParam;
    using View = ViewOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (Insertion const& c : INSERTIONS) {
        SCOPED_TRACE(c.row);
        for (bool heap : {false, true}) {
            String s(make<String>(c.before).c_str());
            if (heap) s.extendBuf(N + 3);
            Text const source = make<String>(c.source != nullptr ? c.source : "");
            String& result = s.insert(c.position, c.source != nullptr ? source.c_str() : nullptr, c.length);
            EXPECT_EQ(&result, &s);
            EXPECT_EQ(contentOf(s), make<String>(c.after));
            EXPECT_TRUE(isTerminated(s));
            EXPECT_EQ(s.sizeBuf(), heap ? N + 3 : N);
        }
    }
    String viewed(make<String>("ad").c_str());
    viewed.insert(1, View(make<String>("bcx").c_str(), 2));
    EXPECT_EQ(contentOf(viewed), make<String>("abcd"));
}

TYPED_TEST(InlineTextChange, inserting_fills_the_capacity_and_grows_exactly) {
    using String = TypeParam;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s = TestFixture::appended(N - 1);
    s.insert(1, make<String>("!").c_str());
    EXPECT_TRUE(isInside(s));
    EXPECT_EQ(s.size(), N);
    s.insert(1, make<String>("?").c_str());
    EXPECT_EQ(s.sizeBuf(), N + 1);
    EXPECT_EQ(contentOf(s), make<String>("a?!") + TestFixture::letters(N - 1).substr(1));
    s.insert(0, make<String>("12").c_str());
    EXPECT_EQ(s.sizeBuf(), N + 3);
    EXPECT_EQ(contentOf(s), make<String>("12a?!") + TestFixture::letters(N - 1).substr(1));
}

namespace {

struct Replacement {
    Row row;
    char const* before;
    std::uint64_t position;
    std::uint64_t count;
    char const* source;
    std::uint64_t length;
    char const* after;
};

Replacement const REPLACEMENTS[] = {
    {{}, "abcd", 1, 2, "xy", 0, "axyd"}, {{}, "abcd", 1, 2, "x", 0, "axd"},    {{}, "abcd", 1, 2, "xyz", 0, "axyzd"},
    {{}, "abcd", 1, 2, "", 0, "ad"},     {{}, "abcd", 1, 2, nullptr, 9, "ad"}, {{}, "abcd", 1, FAR, "x", 0, "ax"},
    {{}, "abcd", 1, 0, "x", 0, "axbcd"}, {{}, "abcd", 4, 2, "x", 0, "abcdx"},  {{}, "abcd", 5, 2, "x", 0, "abcd"},
    {{}, "abcd", 0, 4, "xyz", 2, "xy"},  {{}, "abcd", 0, 9, "", 0, ""},        {{}, "", 0, 0, "x", 0, "x"}};

} // namespace

TYPED_TEST(InlineTextChange, replaces) {
    using String = TypeParam;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (Replacement const& c : REPLACEMENTS) {
        SCOPED_TRACE(c.row);
        for (bool heap : {false, true}) {
            String s(make<String>(c.before).c_str());
            if (heap) s.extendBuf(N + 3);
            Text const source = make<String>(c.source != nullptr ? c.source : "");
            EXPECT_EQ(&s.replace(c.position, c.count, c.source != nullptr ? source.c_str() : nullptr, c.length), &s);
            EXPECT_EQ(contentOf(s), make<String>(c.after));
            EXPECT_TRUE(isTerminated(s));
            EXPECT_EQ(s.sizeBuf(), heap ? N + 3 : N);
        }
    }
}

TYPED_TEST(InlineTextChange, replacing_grows_exactly) {
    using String = TypeParam;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    String s = TestFixture::appended(N);
    s.replace(2, 3, make<String>("xyz").c_str());
    EXPECT_TRUE(isInside(s));
    s.replace(2, 3, make<String>("123456").c_str());
    EXPECT_EQ(s.sizeBuf(), N + 3);
    EXPECT_EQ(contentOf(s), make<String>("ab123456") + TestFixture::letters(N).substr(5));
}

TYPED_TEST(InlineTextChange, inserting_and_replacing_move_the_rest_with_its_zeros) {
    using String = TypeParam;
    using Char = CharOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (std::uint64_t length : {std::uint64_t{1}, N}) {
        String s(make<String>("abcdef").c_str());
        s[1] = Char();
        s[4] = Char();
        s.insert(3, TestFixture::letters(length).c_str());
        EXPECT_EQ(contentOf(s), make<String>(std::string_view("a\0c", 3)) + TestFixture::letters(length) +
                                    make<String>(std::string_view("d\0f", 3)));
        s.replace(3, length, TestFixture::letters(2 * length).c_str());
        EXPECT_EQ(contentOf(s), make<String>(std::string_view("a\0c", 3)) + TestFixture::letters(2 * length) +
                                    make<String>(std::string_view("d\0f", 3)));
    }
}

TYPED_TEST(InlineTextChange, inserts_and_replaces_with_parts_of_its_own_text) {
    using String = TypeParam;
    using Char = CharOf<String>;
    using Text = TextOf<String>;
    constexpr std::uint64_t N = Kind<String>::INSIDE;
    for (std::uint64_t size : {std::uint64_t{6}, N / 2, N / 2 + 1, N - 1, N + 7}) {
        Text const before = TestFixture::letters(size);
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

TYPED_TEST(InlineTextChange, cuts) {
    using String = TypeParam;
    using Char = CharOf<String>;
    String s(make<String>("abcd").c_str());
    s.cut();
    EXPECT_EQ(contentOf(s), make<String>("abc"));
    s.cut(3);
    s.cut(100);
    EXPECT_EQ(contentOf(s), make<String>("abc"));
    s.cut(1);
    EXPECT_EQ(contentOf(s), make<String>("a"));
    s.cut(0);
    s.cut();
    s.cut();
    EXPECT_EQ(s.size(), 0U);
    EXPECT_TRUE(isTerminated(s));
    s = make<String>("abcd").c_str();
    s.getBuf()[4] = Char('x');
    s.cut(4);
    EXPECT_TRUE(isTerminated(s)) << "a cut behind the end only terminates again";
    s.cut();
    EXPECT_TRUE(isTerminated(s));
}
