#include "basis/text/held_text.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>

using namespace ZOR_Basis;

namespace {

template <class Char>
class HeldTextOf : public testing::Test {};

using HeldUnits = testing::Types<char, WChar>;
TYPED_TEST_SUITE(HeldTextOf, HeldUnits, );

} // namespace

TYPED_TEST(HeldTextOf, keeps_a_copy_of_every_length_when_its_source_changes) {
    using Text = std::basic_string<TypeParam>;
    for (std::size_t size : {1u, 2u, 254u, 255u, 256u, 257u, 5000u}) {
        Text source(size, 'a');
        source[size / 2] = 'b';
        Text const before = source;
        detail::HeldText<TypeParam> const held(source.c_str(), size);
        std::fill(source.begin(), source.end(), TypeParam('x'));
        EXPECT_EQ(Text(held.orElse(source.c_str())), before) << size;
    }
}

TYPED_TEST(HeldTextOf, ends_at_an_inner_zero_and_pads_with_zeros) {
    TypeParam const source[] = {'a', 0, 'c', 'd'};
    detail::HeldText<TypeParam> const held(source, 4);
    TypeParam const* const copy = held.orElse(nullptr);
    EXPECT_TRUE(copy[0] == 'a' && copy[1] == 0 && copy[2] == 0 && copy[3] == 0 && copy[4] == 0);
}

TYPED_TEST(HeldTextOf, of_length_0_is_the_source) {
    TypeParam const source[] = {'a', 0};
    EXPECT_EQ(detail::HeldText<TypeParam>(source, 0).orElse(source), source);
    EXPECT_EQ(detail::HeldText<TypeParam>(nullptr, 0).orElse(nullptr), nullptr);
}
