// A manager that always returns the end of its block.

#include "basis/memory/stack_mem_mgr.h"

#include <gtest/gtest.h>

#include <cstring>

using namespace ZOR_Basis;

TEST(StackMemMgr, Kept_memory_02_always_gives_the_end_of_its_block) {
    MemMgrPtr const manager(MemMgr::makeStack(4096, nullptr));
    void* const end = manager->alloc(1);
    ASSERT_NE(end, nullptr);
    EXPECT_EQ(manager->alloc(100'000), end);
    EXPECT_EQ(manager->alloc(0), end);
    std::memset(static_cast<char*>(end) - 4096, 1, 4096); // the block lies before it
    manager->free(end);
    EXPECT_EQ(manager->alloc(1), end);
    EXPECT_EQ(manager->alloc(), nullptr);
}

TEST(StackMemMgr, borrows_a_buffer) {
    char buffer[256];
    {
        MemMgrPtr const manager(MemMgr::makeStack(sizeof buffer, buffer));
        EXPECT_EQ(manager->alloc(8), buffer + 256);
        manager->free(buffer);
        EXPECT_EQ(manager->alloc(8), buffer + 256);
        void* const p = MemMgr::makeStd()->alloc(10);
        manager->free(p, 10); // the heap's, whatever the manager
    }
    buffer[0] = 1; // still ours
}
