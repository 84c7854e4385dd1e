#include "basis/memory/chunk.h"

#include <gtest/gtest.h>

#include <cstring>
#include <memory>

using namespace ZOR_Basis;

TEST(Chunk, has_memory_of_its_own) {
    std::unique_ptr<Chunks::Unit> const chunk(makeChunk(100));
    ASSERT_NE(chunk, nullptr);
    EXPECT_EQ(chunk->value.size, 100u);
    EXPECT_TRUE(chunk->value.owned);
    EXPECT_EQ(chunk->next, nullptr);
    std::memset(chunk->value.data, 1, 100);
}

TEST(Chunk, leaves_borrowed_memory_alone) {
    char buffer[16] = "still here";
    std::unique_ptr<Chunks::Unit> chunk(borrowChunk(sizeof buffer, buffer));
    ASSERT_NE(chunk, nullptr);
    EXPECT_EQ(chunk->value.size, sizeof buffer);
    EXPECT_EQ(chunk->value.data, buffer);
    EXPECT_FALSE(chunk->value.owned);
    chunk.reset();
    EXPECT_STREQ(buffer, "still here");
}
