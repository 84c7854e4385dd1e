#include <zor_basis/text.h>

#include <gtest/gtest.h>

#include <cstring>

using namespace ZOR_Basis;

TEST(BufStrSetSize, ends_a_text_that_was_written_directly) {
    BufStr<15> text("before");
    std::memcpy(text.getBuf(), "0123456789", 10);
    EXPECT_EQ(text.setSize(4).size(), 4u);
    EXPECT_STREQ(text.c_str(), "0123");
    EXPECT_STREQ(text.setSize(0).c_str(), "");
}

TEST(BufStrSetSize, reaches_up_to_the_capacity_of_a_block) {
    BufStr<255> text;
    text.extendBuf(1000);
    std::memset(text.getBuf(), 'x', 1000);
    text.setSize(1000);
    EXPECT_EQ(text.size(), 1000u);
    EXPECT_EQ(std::strlen(text.c_str()), 1000u);
}
