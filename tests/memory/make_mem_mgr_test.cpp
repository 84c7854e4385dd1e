#include "basis/memory/sm_bl_mem_mgr.h"
#include "basis/memory/stack_mem_mgr.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(MakeMemMgr, passes_the_numbers_of_small_blocks_on_in_their_order) {
    MemMgrPtr const made(MemMgr::makeSmlBlk(16, 40, 1000, 8));
    auto* const manager = dynamic_cast<SmBlMemMgr*>(static_cast<MemMgr*>(made));
    ASSERT_NE(manager, nullptr);
    SmBlMemMgr same(16, 40, 1000, 8);
    for (int i = 0; i < 100; ++i) {
        void* const place = manager->alloc();
        ASSERT_NE(place, nullptr);
        EXPECT_EQ(reinterpret_cast<std::uintptr_t>(place) % 8, 0u);
        ASSERT_NE(same.alloc(), nullptr);
        ASSERT_EQ(manager->chunkSize(), same.chunkSize());
        ASSERT_EQ(manager->chunkCount(), same.chunkCount());
    }
    EXPECT_GT(manager->chunkCount(), 1u);
    EXPECT_EQ(manager->alloc(17), nullptr);
}

TEST(MakeMemMgr, lays_a_stack_into_the_buffer_that_is_given) {
    char buffer[64];
    MemMgrPtr const made(MemMgr::makeStack(sizeof buffer, buffer));
    EXPECT_NE(dynamic_cast<StackMemMgr*>(static_cast<MemMgr*>(made)), nullptr);
    EXPECT_EQ(made->alloc(1), buffer + sizeof buffer);
    MemMgrPtr const own(MemMgr::makeStack(sizeof buffer, nullptr));
    EXPECT_NE(own->alloc(1), buffer + sizeof buffer);
}
