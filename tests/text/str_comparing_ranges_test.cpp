// Range algorithms that clang 14 cannot compile with this standard library, for any element type.

#include "zor_basis/files/f_path.h"
#include "zor_basis/text.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

template <class Text>
class StrComparingRanges : public testing::Test {};

using RangeTexts = testing::Types<Str, BufStr<15>, BufStr<255>, HeapStr, FPath>;
TYPED_TEST_SUITE(StrComparingRanges, RangeTexts, );

} // namespace

TYPED_TEST(StrComparingRanges, are_found_by_literals_and_standard_strings) {
    std::vector<std::string> const own{"tray", "a", "z", "media", "a", "stacker"};
    std::vector<TypeParam> names(own.begin(), own.end());
    std::ranges::sort(names);
    EXPECT_EQ(std::ranges::equal_range(names, "a").size(), 2U);
    EXPECT_EQ(std::ranges::equal_range(names, "tray").size(), 1U);
    EXPECT_EQ(std::ranges::equal_range(names, "trays").size(), 0U);
    EXPECT_EQ(std::ranges::equal_range(names, own[1]).size(), 2U);
    EXPECT_EQ(std::ranges::equal_range(names, BufStr<15>("media")).size(), 1U);
}
