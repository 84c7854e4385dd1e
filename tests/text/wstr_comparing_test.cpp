// Wide texts have only the comparisons that their headers declare; no other compiles.

#include "zor_basis/files/f_path.h"
#include "zor_basis/files/wc_path.h"
#include "zor_basis/text.h"

#include <gtest/gtest.h>

#include <compare>
#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <type_traits>

using namespace ZOR_Basis;

namespace {

template <class A, class B>
concept Equal = requires(A const& a, B const& b) {
    a == b;
};
template <class A, class B>
concept Unequal = requires(A const& a, B const& b) {
    a != b;
};
template <class A, class B>
concept Less = requires(A const& a, B const& b) {
    a < b;
};
template <class A, class B>
concept Greater = requires(A const& a, B const& b) {
    a > b;
};
template <class A, class B>
concept NotGreater = requires(A const& a, B const& b) {
    a <= b;
};
template <class A, class B>
concept NotLess = requires(A const& a, B const& b) {
    a >= b;
};
template <class A, class B>
concept ThreeWay = requires(A const& a, B const& b) {
    a <=> b;
};

template <class Object, class A, class B>
inline constexpr bool TAKES = std::is_invocable_v<Object, A const&, B const&>;

template <class A, class B>
inline constexpr bool HAS_EQUALITY = Equal<A, B>&& Unequal<A, B>&& TAKES<std::equal_to<>, A, B>;
template <class A, class B>
inline constexpr bool HAS_STRICT_ORDER =
    Less<A, B>&& Greater<A, B>&& TAKES<std::less<>, A, B>&& TAKES<std::greater<>, A, B>;
template <class A, class B>
inline constexpr bool HAS_NO_STRICT_ORDER =
    !Less<A, B> && !Greater<A, B> && !TAKES<std::less<>, A, B> && !TAKES<std::greater<>, A, B>;
template <class A, class B>
inline constexpr bool HAS_NO_OTHER_ORDER =
    !NotGreater<A, B> && !NotLess<A, B> && !ThreeWay<A, B> && !TAKES<std::less_equal<>, A, B> &&
    !TAKES<std::greater_equal<>, A, B> && !TAKES<std::ranges::less, A, B> && !TAKES<std::ranges::greater, A, B> &&
    !TAKES<std::ranges::less_equal, A, B> && !TAKES<std::ranges::greater_equal, A, B> &&
    !TAKES<std::compare_three_way, A, B>;
template <class A, class B>
inline constexpr bool IS_INCOMPARABLE = !Equal<A, B> && !Unequal<A, B> && !TAKES<std::equal_to<>, A, B> &&
                                        HAS_NO_STRICT_ORDER<A, B> && HAS_NO_OTHER_ORDER<A, B>;

/// Equality with all the others, "<" and ">" between wide texts, no other comparison.
template <class Wide, class... Others>
inline constexpr bool IS_AS_DECLARED = (... && (HAS_EQUALITY<Wide, Others> && HAS_STRICT_ORDER<Wide, Others> &&
                                                HAS_NO_OTHER_ORDER<Wide, Others>));
template <class Wide, class... Plain>
inline constexpr bool IS_ONLY_EQUAL = (... && (HAS_EQUALITY<Wide, Plain> && HAS_EQUALITY<Plain, Wide> &&
                                               HAS_NO_STRICT_ORDER<Wide, Plain> && HAS_NO_STRICT_ORDER<Plain, Wide> &&
                                               HAS_NO_OTHER_ORDER<Wide, Plain> && HAS_NO_OTHER_ORDER<Plain, Wide>));
template <class Text, class... Others>
inline constexpr bool COMPARES_WITH_NONE = (... && (IS_INCOMPARABLE<Text, Others> && IS_INCOMPARABLE<Others, Text>));

static_assert(IS_AS_DECLARED<WStr, WStr, WBStr, WFxStr, WcPath> && IS_AS_DECLARED<WBStr, WStr, WBStr, WFxStr, WcPath>);
static_assert(IS_AS_DECLARED<WFxStr, WStr, WBStr, WFxStr, WcPath> &&
              IS_AS_DECLARED<WcPath, WStr, WBStr, WFxStr, WcPath>);
static_assert(IS_ONLY_EQUAL<WStr, WChar const*, WChar*, WChar[4]> &&
              IS_ONLY_EQUAL<WBStr, WChar const*, WChar*, WChar[4]>);
static_assert(IS_ONLY_EQUAL<WFxStr, WChar const*, WChar*, WChar[4]>);
static_assert(IS_ONLY_EQUAL<WcPath, WChar const*, WChar*, WChar[4]>);
static_assert(COMPARES_WITH_NONE<WStr, void const*, void*, char const*, int const*, Str, BufStr<15>, std::string>);
static_assert(COMPARES_WITH_NONE<WBStr, void const*, void*, char const*, int const*, Str, HeapStr, std::string_view>);
static_assert(COMPARES_WITH_NONE<WcPath, void const*, void*, char const*, int const*, FPath, std::string_view>);
static_assert(COMPARES_WITH_NONE<Str, void const*, void*, unsigned char const*, int*, WStr, WChar const*>);
static_assert(COMPARES_WITH_NONE<BufStr<15>, void const*, void*, unsigned char const*, int*, WBStr, WChar const*>);
static_assert(COMPARES_WITH_NONE<HeapStr, void const*, void*, unsigned char const*, int*, WFxStr, WChar const*>);
static_assert(COMPARES_WITH_NONE<FPath, void const*, void*, unsigned char const*, int*, WcPath, WChar const*>);
static_assert(COMPARES_WITH_NONE<Str, std::string_view>, "nothing terminates a standard view");

} // namespace

TEST(WStrComparing, Kept_wide_01_function_objects_reverse_wide_texts_too) {
    WBStr const a(ZB_W("a"));
    WStr const b(ZB_W("b"));
    EXPECT_TRUE(std::less<>()(b, a) && !std::less<>()(a, b));
    EXPECT_TRUE(std::greater<>()(a, b) && !std::greater<>()(b, a));
    EXPECT_TRUE(std::equal_to<>()(a, ZB_W("a")) && std::not_equal_to<>()(ZB_W("a"), b));
    std::map<WBStr, int, std::less<>> const sizes{{ZB_W("a"), 1}, {ZB_W("c"), 3}, {ZB_W("b"), 2}};
    EXPECT_EQ(sizes.begin()->second, 3);
    EXPECT_EQ(sizes.find(b)->second, 2);
}
