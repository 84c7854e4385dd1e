#include "zor_basis/flat.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <cstring>
#include <string>

TEST(ZbStrDup, copies_text_into_a_block_that_the_runtime_frees) {
    for (std::string const& text : {std::string(), std::string("a"), std::string(1000, 'x')}) {
        char* copy = ZB_StrDup(text.c_str());
        ASSERT_NE(copy, nullptr);
        EXPECT_NE(copy, text.c_str());
        EXPECT_STREQ(copy, text.c_str());
        std::free(copy);
    }
}

TEST(ZbStrDup, gives_null_for_null) { EXPECT_EQ(ZB_StrDup(nullptr), nullptr); }
