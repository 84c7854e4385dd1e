// Standard views as sources of narrow texts.

#include "zor_basis/files/f_path.h"
#include "zor_basis/text.h"

#include "tests/text/call_content.h"

#include <gtest/gtest.h>

#include <string>
#include <string_view>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

namespace {

template <class Text>
class ViewOps : public testing::Test {};

using ViewedTexts = testing::Types<BufStr<15>, BufStr<255>, HeapStr, FPath>;
TYPED_TEST_SUITE(ViewOps, ViewedTexts, );

template <class Text>
class ViewOpsOfBufStr : public testing::Test {};

using ViewedBufStrs = testing::Types<BufStr<15>, BufStr<255>>;
TYPED_TEST_SUITE(ViewOpsOfBufStr, ViewedBufStrs, );

/// Not terminated, so that a sanitizer sees every read behind the end.
struct Unterminated {
    explicit Unterminated(std::string_view text) : bytes(text.begin(), text.end()) {}
    operator std::string_view() const { return {bytes.data(), bytes.size()}; }
    std::string_view get() const { return *this; }
    std::vector<char> bytes;
};

} // namespace

static_assert(!std::is_constructible_v<Str, std::string_view> && !std::is_assignable_v<Str&, std::string_view>);
static_assert(!std::is_convertible_v<Str, std::string_view> && !std::is_convertible_v<HeapStr, std::string_view>);

TYPED_TEST(ViewOps, are_copied_as_standard_strings_are) {
    using namespace std::string_literals;
    static_assert(std::is_convertible_v<std::string_view, TypeParam>);
    for (std::string const& text : {""s, "a"s, "abc"s, "a name of 16 byt"s, "ab\0cd"s, "\0"s, "\0ab"s,
                                    std::string(255, 'x'), std::string(300, 'y')}) {
        SCOPED_TRACE(text);
        Unterminated const view(text);
        TypeParam const expected(text);
        EXPECT_EQ(contentOfAny(TypeParam(view.get())), contentOfAny(expected));
        TypeParam const converted = view.get();
        EXPECT_EQ(contentOfAny(converted), contentOfAny(expected));
        EXPECT_EQ(converted.c_str()[converted.size()], '\0');
        TypeParam assigned("what was there before");
        EXPECT_EQ(&(assigned = view.get()), &assigned);
        EXPECT_EQ(contentOfAny(assigned), contentOfAny(expected));
        EXPECT_EQ(assigned.c_str()[assigned.size()], '\0');
    }
}

TYPED_TEST(ViewOps, of_nothing_are_the_empty_text_and_never_measured) {
    char const* const text = "abc";
    EXPECT_EQ(contentOfAny(TypeParam(std::string_view())), "");
    EXPECT_EQ(contentOfAny(TypeParam(std::string_view(text, 0))), "");
    TypeParam assigned("old");
    assigned = std::string_view(text, 0);
    EXPECT_EQ(contentOfAny(assigned), "");
    assigned = "old";
    assigned = std::string_view();
    EXPECT_EQ(contentOfAny(assigned), "");
}

TYPED_TEST(ViewOps, of_the_own_text_are_copied_first) {
    TypeParam text("a text that is longer than fifteen bytes");
    text = std::string_view(text).substr(2);
    EXPECT_EQ(contentOfAny(text), "text that is longer than fifteen bytes");
    text = std::string_view(text).substr(5, 7);
    EXPECT_EQ(contentOfAny(text), "that is");
    text = std::string_view(text).substr(0, 4);
    EXPECT_EQ(contentOfAny(text), "that");
    text = std::string_view(text);
    EXPECT_EQ(contentOfAny(text), "that");
    text = std::string_view(text).substr(1, 0);
    EXPECT_EQ(contentOfAny(text), "");
}

TYPED_TEST(ViewOpsOfBufStr, extend_a_text_by_views) {
    Unterminated const view("abc");
    char const* const plain = "xyz";
    TypeParam text;
    EXPECT_EQ(&text.add(view.get()), &text);
    text += view.get().substr(1);
    text << view.get().substr(2) << std::string_view(plain, 0) << std::string_view();
    EXPECT_EQ(contentOfAny(text), "abcbcc");
    text.add(std::string_view(text).substr(3));
    EXPECT_EQ(contentOfAny(text), "abcbccbcc");
}

TEST(ViewOpsOfFPath, extend_a_path_by_views) {
    Unterminated const view("abc");
    FPath path("d");
    EXPECT_EQ(&path.add(view.get()), &path);
    path += view.get().substr(1);
    path.add(std::string_view(path.c_str(), 0));
    path += std::string_view();
    EXPECT_EQ(contentOfAny(path), "d/abc/bc");
    path << view.get();
    EXPECT_EQ(contentOfAny(path), "d/abc/bcabc");
}
