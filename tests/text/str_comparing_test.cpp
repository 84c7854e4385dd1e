// Narrow texts compare by content with each other, with plain text and with standard strings: on either side of an
// operator, and through the standard's function objects.

#include "zor_basis/files/f_path.h"
#include "zor_basis/text.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <compare>
#include <cstring>
#include <functional>
#include <map>
#include <set>
#include <string>
#include <string_view>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// Holds a text of each kind in its own memory.
template <class T>
struct Held {
    explicit Held(std::string const& text) : own(text), value(own) {}
    T const& get() const { return value; }
    std::string own;
    T value;
};
template <>
struct Held<char const*> {
    explicit Held(std::string const& text) : own(text), value(own.c_str()) {}
    char const* const& get() const { return value; }
    std::string own;
    char const* value;
};
template <>
struct Held<char*> {
    explicit Held(std::string const& text) : own(text), value(own.data()) {}
    char* const& get() const { return value; }
    std::string own;
    char* value;
};
template <>
struct Held<char[100]> {
    explicit Held(std::string const& text) { std::strcpy(value, text.c_str()); }
    char const (&get() const)[100] { return value; }
    char value[100];
};
/// Converts to a pointer, as old string classes do.
struct OldString {
    explicit OldString(std::string const& text) : own(text) {}
    operator char const*() const { return own.c_str(); }
    std::string own;
};
/// Not terminated.
template <>
struct Held<std::string_view> {
    explicit Held(std::string const& text) : own(text.begin(), text.end()), value(own.data(), own.size()) {}
    std::string_view const& get() const { return value; }
    std::vector<char> own;
    std::string_view value;
};

/// Collects the names of comparisons whose results are wrong.
struct Findings {
    void check(char const* name, bool result, bool expected) {
        if (result != expected) names += std::string(name) + " ";
    }
    std::string names;
};

template <class A, class B>
void checkOperators(Findings& found, A const& a, B const& b, int order) {
    found.check("==", a == b, order == 0);
    found.check("!=", a != b, order != 0);
    found.check("<", a < b, order < 0);
    found.check(">", a > b, order > 0);
    found.check("<=", a <= b, order <= 0);
    found.check(">=", a >= b, order >= 0);
    found.check("<=>", (a <=> b) == (order <=> 0), true);
}

template <class A, class B>
void checkFunctionObjects(Findings& found, A const& a, B const& b, int order) {
    found.check("equal_to", std::equal_to<>()(a, b), order == 0);
    found.check("not_equal_to", std::not_equal_to<>()(a, b), order != 0);
    found.check("less", std::less<>()(a, b), order < 0);
    found.check("greater", std::greater<>()(a, b), order > 0);
    found.check("less_equal", std::less_equal<>()(a, b), order <= 0);
    found.check("greater_equal", std::greater_equal<>()(a, b), order >= 0);
}

template <class A, class B>
void checkRangeObjects(Findings& found, A const& a, B const& b, int order) {
    found.check("ranges::equal_to", std::ranges::equal_to()(a, b), order == 0);
    found.check("ranges::not_equal_to", std::ranges::not_equal_to()(a, b), order != 0);
    found.check("ranges::less", std::ranges::less()(a, b), order < 0);
    found.check("ranges::greater", std::ranges::greater()(a, b), order > 0);
    found.check("ranges::less_equal", std::ranges::less_equal()(a, b), order <= 0);
    found.check("ranges::greater_equal", std::ranges::greater_equal()(a, b), order >= 0);
    if constexpr (!std::is_array_v<A> && !std::is_array_v<B>) { // which the standard's object refuses
        found.check("compare_three_way", std::compare_three_way()(a, b) == (order <=> 0), true);
    }
}

std::vector<std::string> const& words() {
    static std::vector<std::string> const all{"",
                                              "a",
                                              "ab",
                                              "b",
                                              "z",
                                              "\xE9t\xE9",
                                              "tray",
                                              "trays",
                                              "a name of 16 byt",
                                              "a name of 16 byu",
                                              std::string(70, 'x'),
                                              std::string(69, 'x') + "\xFF"};
    return all;
}

/// Compares every word with every other, so that no order of addresses gives the expected results.
template <class A, class B>
void compareAll(bool throughRanges) {
    for (std::string const& one : words()) {
        for (std::string const& other : words()) {
            Held<A> const a(one);
            Held<B> const b(other);
            int const order = std::strcmp(one.c_str(), other.c_str());
            Findings found;
            checkOperators(found, a.get(), b.get(), order);
            checkFunctionObjects(found, a.get(), b.get(), order);
            if constexpr (!std::is_same_v<A, OldString> && !std::is_same_v<B, OldString>) {
                if (throughRanges) checkRangeObjects(found, a.get(), b.get(), order);
            }
            ASSERT_EQ(found.names, "") << '"' << one << "\" and \"" << other << '"';
        }
    }
}

template <class A, class... Others>
void compareWith() {
    (compareAll<A, Others>(true), ...);
    (compareAll<Others, A>(true), ...);
}

/// The other way round, too, where this is done for each of them.
template <class A, class... Others>
void compareOnTheLeft() {
    (compareAll<A, Others>(true), ...);
}

template <class Text>
class StrComparing : public testing::Test {};

using ComparedTexts = testing::Types<Str, BufStr<15>, BufStr<255>, HeapStr, FPath>;
TYPED_TEST_SUITE(StrComparing, ComparedTexts, );

template <class Text>
class StrComparingOwner : public testing::Test {};

using Owners = testing::Types<BufStr<15>, BufStr<255>, HeapStr, FPath>;
TYPED_TEST_SUITE(StrComparingOwner, Owners, );

} // namespace

TYPED_TEST(StrComparing, sees_the_text_of_pointers_and_arrays) {
    compareWith<TypeParam, char const*, char*, char[100]>();
}

TYPED_TEST(StrComparing, sees_the_text_of_standard_strings) { compareWith<TypeParam, std::string>(); }

TYPED_TEST(StrComparing, sees_the_text_of_every_other_text_type) {
    compareOnTheLeft<TypeParam, Str, BufStr<15>, BufStr<255>, HeapStr, FPath>();
}

TYPED_TEST(StrComparing, sees_the_text_of_whatever_converts_to_a_pointer) {
    compareAll<TypeParam, OldString>(false);
    compareAll<OldString, TypeParam>(false);
}

TYPED_TEST(StrComparingOwner, sees_the_text_of_a_view_without_a_terminator) {
    compareWith<TypeParam, std::string_view>();
}

TYPED_TEST(StrComparing, finds_literals_in_ordered_containers) {
    std::vector<std::string> const own{"tray", "a", "z", "media", "stacker"};
    std::map<TypeParam, int, std::less<>> sizes;
    std::set<TypeParam, std::greater<>> names;
    for (std::string const& name : own) {
        sizes.emplace(name, static_cast<int>(name.size()));
        names.emplace(name);
    }
    for (std::string const& name : own) {
        Held<char const*> const plain(name);
        EXPECT_TRUE(sizes.contains(plain.get())) << name;
        EXPECT_TRUE(names.contains(plain.get())) << name;
        EXPECT_TRUE(sizes.contains(name));
        EXPECT_EQ(sizes.find(BufStr<15>(name))->second, static_cast<int>(name.size()));
    }
    EXPECT_TRUE(sizes.contains("tray"));
    EXPECT_EQ(sizes.find("stacker")->second, 7);
    EXPECT_EQ(sizes.lower_bound("n")->first, "stacker");
    EXPECT_FALSE(sizes.contains("trays"));
    EXPECT_EQ(*names.begin(), "z");
    EXPECT_EQ(names.count("b"), 0U);
}

TEST(StrComparing, needs_no_string_to_search_a_container) {
    std::map<BufStr<15>, int, std::less<>> trays{{"tray1", 500}, {"tray2", 250}};
    bool const known = trays.contains("tray2");
    EXPECT_TRUE(known);
}

TYPED_TEST(StrComparing, finds_literals_in_sorted_ranges) {
    std::vector<std::string> const own{"tray", "a", "z", "media", "a", "stacker"};
    std::vector<TypeParam> names(own.begin(), own.end());
    std::ranges::sort(names);
    EXPECT_EQ(names.front(), "a");
    EXPECT_EQ(names.back(), "z");
    EXPECT_TRUE(std::ranges::binary_search(names, "tray"));
    EXPECT_TRUE(std::ranges::binary_search(names, own[3]));
    EXPECT_TRUE(std::ranges::binary_search(names, Held<char const*>("stacker").get()));
    EXPECT_FALSE(std::ranges::binary_search(names, "trays"));
    EXPECT_EQ(std::ranges::upper_bound(names, "a") - std::ranges::lower_bound(names, "a"), 2);
    EXPECT_EQ(*std::ranges::find(names, "media"), "media");
    std::ranges::sort(names, std::ranges::greater());
    EXPECT_EQ(names.front(), "z");
    EXPECT_TRUE(std::ranges::binary_search(names, "media", std::ranges::greater()));
    EXPECT_TRUE(std::binary_search(names.begin(), names.end(), "media", std::greater<>()));
}

TYPED_TEST(StrComparingOwner, Kept_text_01_the_right_hand_size_decides_beside_a_view_too) {
    struct Case {
        Row row;
        std::string text;
        std::string view;
        bool textFirst;
        bool viewFirst;
    };
    using namespace std::string_literals;
    for (Case const& c :
         {Case{{}, "abc", "abc", true, true}, Case{{}, "abc", "ab", false, false}, Case{{}, "", "", true, true},
          Case{{}, "", "a", false, false}, Case{{}, "a", "", false, false}, Case{{}, "", "\0x"s, false, true},
          Case{{}, "ab\0\0"s, "ab\0x"s, true, true}, Case{{}, "ab\0\0"s, "ab"s, false, false}}) {
        SCOPED_TRACE(c.row);
        TypeParam const text(c.text);
        std::string const string(c.view);
        Held<std::string_view> const view(c.view);
        EXPECT_EQ(text == view.get(), c.textFirst);
        EXPECT_EQ(text != view.get(), !c.textFirst);
        EXPECT_EQ(view.get() == text, c.viewFirst);
        EXPECT_EQ(view.get() != text, !c.viewFirst);
        EXPECT_EQ(text == string, c.textFirst) << "a standard string says the same";
        EXPECT_EQ(string == text, c.viewFirst);
    }
}

TYPED_TEST(StrComparingOwner, a_view_of_a_part_of_a_text_is_not_the_text) {
    TypeParam const text("abcdef");
    std::string_view const whole(text);
    EXPECT_TRUE(text == whole && whole == text);
    EXPECT_FALSE(text == whole.substr(0, 3));
    EXPECT_FALSE(whole.substr(0, 3) == text);
    EXPECT_TRUE(whole.substr(0, 3) < text && text > whole.substr(0, 3));
}

TYPED_TEST(StrComparingOwner, Kept_text_02_a_view_is_ordered_up_to_its_first_zero) {
    TypeParam const text("ab");
    EXPECT_TRUE(std::is_eq(text <=> std::string_view("ab\0z", 4)));
    EXPECT_TRUE(text <= std::string_view("ab\0z", 4) && text >= std::string_view("ab\0z", 4));
    EXPECT_TRUE(text < std::string_view("b") && std::string_view("a") < text);
    EXPECT_TRUE(text > std::string_view() && std::string_view() <= text);
}

TEST(StrComparing, keeps_the_asymmetry_of_sizes_in_function_objects) {
    std::string const own("abcdef");
    Str const part(own.c_str(), 3);
    EXPECT_TRUE(std::equal_to<>()(part, "abcdef")) << "plain text is compared whole";
    EXPECT_FALSE(std::equal_to<>()("abcdef", part)) << "the view stands on the right and decides";
    EXPECT_TRUE(std::ranges::equal_to()(std::string("abc"), part));
    EXPECT_FALSE(std::less<>()(part, "abcdef")) << "ordering does not look at sizes";
    EXPECT_FALSE(std::less<>()("abcdef", part));
}
