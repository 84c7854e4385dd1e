// The page behind a text is made unreadable here.

#include "tests/support/vectors.h"
#include "tests/text/last_page_posix.h"
#include "zor_basis/text/word_ops.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis::detail;

namespace {

struct CompareTextWaysPosix : EachVectors {};

} // namespace

INSTANTIATE_FOR_EACH_VECTORS(CompareTextWaysPosix);

TEST_P(CompareTextWaysPosix, read_no_page_behind_a_terminator) {
    LastPage first;
    LastPage second;
    for (std::size_t size = 1; size < 300; ++size) {
        std::string const text(size, 'x');
        char const* a = first.textAtTheEnd(text);
        char const* b = second.textAtTheEnd(text);
        for (std::uint64_t claimed : {size + 1, size + 70, size + 200, size + 5000}) {
            ASSERT_TRUE(sameTexts(a, b, claimed)) << size;
            ASSERT_EQ(compareTexts(a, claimed, b, claimed), 0) << size;
            ASSERT_FALSE(sameTexts(a, b + 1, claimed)) << size;
            ASSERT_GT(compareTexts(a, claimed, b + 1, claimed), 0) << size;
        }
    }
}
