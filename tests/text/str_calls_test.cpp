// Every documented way to construct, assign, extend and stream a narrow text keeps its meaning, whatever overloads are
// added. Where two overloads are viable, their effects differ, so that the result shows which one was chosen.

#include "zor_basis/files/f_path.h"
#include "zor_basis/text.h"

#include "tests/support/table.h"
#include "tests/text/call_content.h"

#include <gtest/gtest.h>

#include <string>
#include <type_traits>

using namespace ZOR_Basis;

namespace {

template <class Text>
class StrCalls : public testing::Test {
protected:
    /// Longer than its text.
    char array[8] = {'a', 'b', 'c', '\0', 'x', 'y', 'z', '\0'};
    char* const writable = array;
    char const* const plain = array;
    std::string const string{"abc"};
};

using CalledTexts = testing::Types<BufStr<15>, BufStr<255>, HeapStr, FPath>;
TYPED_TEST_SUITE(StrCalls, CalledTexts, );

template <class Text>
inline constexpr bool MEASURES_ZERO = !std::is_same_v<Text, HeapStr>;

} // namespace

TYPED_TEST(StrCalls, make_a_text_from_every_source) {
    using Text = TypeParam;
    Str const part(this->plain, 2);
    Str const none(this->plain, 0);
    EXPECT_EQ(contentOfAny(Text()), "");
    EXPECT_EQ(contentOfAny(Text{}), "");
    EXPECT_EQ(contentOfAny(Text("abc")), "abc");
    EXPECT_EQ(contentOfAny(Text(this->array)), "abc");
    EXPECT_EQ(contentOfAny(Text(this->writable)), "abc");
    EXPECT_EQ(contentOfAny(Text(this->plain)), "abc");
    EXPECT_EQ(contentOfAny(Text{this->plain}), "abc");
    EXPECT_EQ(contentOfAny(Text(nullptr)), "");
    EXPECT_EQ(contentOfAny(Text(static_cast<char const*>(nullptr))), "");
    EXPECT_EQ(contentOfAny(Text(this->string)), "abc");
    EXPECT_EQ(contentOfAny(Text(std::string("a\0b", 3))), std::string("a\0\0", 3));
    EXPECT_EQ(contentOfAny(Text(part)), "ab");
    EXPECT_EQ(contentOfAny(Text(none)), MEASURES_ZERO<Text> ? "abc" : "");
    EXPECT_EQ(contentOfAny(Text(BufStr<15>("abc"))), "abc");
    EXPECT_EQ(contentOfAny(Text(BufStr<255>("abc"))), "abc");
    EXPECT_EQ(contentOfAny(Text(HeapStr("abc"))), "abc");
    EXPECT_EQ(contentOfAny(Text(FPath("abc"))), "abc");
    Text const converted = this->plain;
    EXPECT_EQ(contentOfAny(converted), "abc");
}

TYPED_TEST(StrCalls, make_a_text_from_a_pointer_and_a_length) {
    using Text = TypeParam;
    EXPECT_EQ(contentOfAny(Text(this->plain, 2)), "ab");
    EXPECT_EQ(contentOfAny(Text(this->array, 2U)), "ab");
    EXPECT_EQ(contentOfAny(Text(this->writable, 2L)), "ab");
    EXPECT_EQ(contentOfAny(Text("abc", std::uint64_t{2})), "ab");
    EXPECT_EQ(contentOfAny(Text(this->plain, sizeof(char))), "a");
    EXPECT_EQ(contentOfAny(Text(this->plain, 0)), MEASURES_ZERO<Text> ? "abc" : "");
    EXPECT_EQ(contentOfAny(Text(nullptr, 3)), "");
    EXPECT_EQ(contentOfAny(Text{"abc", 2}), "ab");
    Text const listed = {"abc", 2};
    EXPECT_EQ(contentOfAny(listed), "ab");
}

TYPED_TEST(StrCalls, assign_every_source) {
    Str const part(this->plain, 2);
    Str const none(this->plain, 0);
    TypeParam text("old");
    EXPECT_EQ(contentOfAny(text = "abc"), "abc");
    EXPECT_EQ(contentOfAny(text = this->array), "abc");
    EXPECT_EQ(contentOfAny(text = this->writable), "abc");
    EXPECT_EQ(contentOfAny(text = part), "ab");
    EXPECT_EQ(contentOfAny(text = none), MEASURES_ZERO<TypeParam> ? "abc" : "");
    EXPECT_EQ(contentOfAny(text = this->string), "abc");
    EXPECT_EQ(contentOfAny(text = nullptr), "");
    EXPECT_EQ(contentOfAny(text = BufStr<15>("abc")), "abc");
    EXPECT_EQ(contentOfAny(text = BufStr<255>("de")), "de");
    EXPECT_EQ(contentOfAny(text = HeapStr("abc")), "abc");
    EXPECT_EQ(contentOfAny(text = FPath("de")), "de");
    EXPECT_EQ(contentOfAny(text = TypeParam("abc")), "abc");
    EXPECT_EQ(contentOfAny(text = text.c_str()), "abc");
    EXPECT_EQ(contentOfAny(text = {}), "");
    static_assert(std::is_same_v<decltype(text = "abc"), TypeParam&>);
}

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wzero-as-null-pointer-constant"

TYPED_TEST(StrCalls, take_a_literal_0_for_a_null_pointer) {
    EXPECT_EQ(contentOfAny(TypeParam(0)), "");
    TypeParam text("old");
    EXPECT_EQ(contentOfAny(text = 0), "");
    EXPECT_TRUE(text == 0 && 0 == text && !(text != 0) && text <= 0 && 0 >= text && !(text < 0));
    EXPECT_EQ(contentOfAny(FPath("a").add(0)), "a");
    EXPECT_EQ(contentOfAny(FPath("a") += 0), "a");
    EXPECT_EQ(contentOfAny(BufStr<15>("a").add(0)), "a") << "or for a zero byte, which appends nothing either";
    EXPECT_EQ(contentOfAny(BufStr<15>("a") << 0), "a0") << "but for a number where an overload takes one";
}

#pragma GCC diagnostic pop

// ---- paths ----------------------------------------------------------------------------------------------------------

TEST(FPathCalls, make_a_path_from_two_parts) {
    std::string const string("d");
    Str const part("dx", 1);
    char const* const plain = "n";
    EXPECT_EQ(contentOfAny(FPath(part, Str("n"))), "d/n");
    EXPECT_EQ(contentOfAny(FPath(part, "n")), "d/n");
    EXPECT_EQ(contentOfAny(FPath("d", plain)), "d/n");
    EXPECT_EQ(contentOfAny(FPath(plain, part)), "n/d");
    EXPECT_EQ(contentOfAny(FPath(string, plain)), "d/n");
    EXPECT_EQ(contentOfAny(FPath(string, string)), "d/d");
    EXPECT_EQ(contentOfAny(FPath(FPath("d"), BufStr<15>("n"))), "d/n");
    EXPECT_EQ(contentOfAny(FPath(FPath("d"), string)), "d/d");
    EXPECT_EQ(contentOfAny(FPath("abc", 1)), "a");
    EXPECT_EQ(contentOfAny(FPath("abc", 1U)), "a");
    EXPECT_EQ(contentOfAny(FPath("abc", 0)), "abc");
    EXPECT_EQ(contentOfAny(FPath("abc", TranslPath())), "abc");
    EXPECT_EQ(contentOfAny(FPath(part, TranslPath())), "d");
    FPath path;
    EXPECT_EQ(contentOfAny(path.assign(part, Str("n"))), "d/n");
    EXPECT_EQ(contentOfAny(path.assign(part, "n")), "d/n");
}

TEST(FPathCalls, extend_a_path) {
    std::string const string("s");
    FPath path("d");
    path.add("abc", 1).add("b").add(Str("cx", 1)).add(FPath("e")).add(string).add(nullptr);
    EXPECT_EQ(contentOfAny(path), "d/a/b/c/e/s");
    path = "d";
    path += "a";
    path += Str("bx", 1);
    path += string;
    path += BufStr<15>("c");
    EXPECT_EQ(contentOfAny(path), "d/a/b/s/c");
    path = "d";
    path << "a" << Str("bx", 1) << 7;
    EXPECT_EQ(contentOfAny(path), "dab7") << "streaming joins nothing";
}

TEST(FPathCalls, append_a_component_of_one_character) {
    struct Case {
        Row row;
        char const* before;
        char added;
        char const* after;
    };
    for (Case const& c : {Case{{}, "dir", 'z', "dir/z"}, Case{{}, "dir/", 'z', "dir/z"}, Case{{}, "", 'z', "z"},
                          Case{{}, "dir", '\0', "dir"}, Case{{}, "dir", '/', "dir//"}}) {
        SCOPED_TRACE(c.row);
        FPath path(c.before);
        EXPECT_EQ(&path.add(c.added), &path);
        EXPECT_EQ(contentOfAny(path), c.after);
        FPath other(c.before);
        EXPECT_EQ(&(other += c.added), &other);
        EXPECT_EQ(contentOfAny(other), c.after);
    }
}
