// The page behind a text is made unreadable here.

#include "basis/text/text_pair.h"
#include "tests/text/last_page_posix.h"

#include <gtest/gtest.h>

#include <string>

using namespace ZOR_Basis::detail;

TEST(CompareTextWaysPosix, read_no_page_behind_a_terminator) {
    LastPage first;
    LastPage second;
    for (std::size_t size = 1; size < 300; ++size) {
        std::string const text(size, 'x');
        char const* a = first.textAtTheEnd(text);
        char const* b = second.textAtTheEnd(text);
        for (std::uint64_t claimed : {size + 70, size + 200}) {
            ASSERT_TRUE(sameLongTexts<GivenPair>(a, b, claimed)) << size;
            ASSERT_EQ(orderOfLongTexts<GivenPair>(a, b, claimed), 0) << size;
            ASSERT_FALSE(sameLongTexts<GivenPair>(a, b + 1, claimed)) << size;
            ASSERT_GT(orderOfLongTexts<GivenPair>(a, b + 1, claimed), 0) << size;
        }
    }
}
