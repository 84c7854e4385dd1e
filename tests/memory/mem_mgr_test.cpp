#include "zor_basis/memory/mem_mgr.h"

#include <gtest/gtest.h>

#include <cstring>

using namespace ZOR_Basis;

TEST(MemMgrStandard, is_the_heap_of_the_runtime) {
    MemMgr* const standard = MemMgr::makeStd();
    EXPECT_EQ(standard, MemMgr::makeStd());
    void* const p = standard->alloc(100);
    ASSERT_NE(p, nullptr);
    std::memset(p, 1, 100);
    standard->free(p);
    void* const q = standard->alloc(100);
    standard->free(q, 7);
    standard->free(nullptr);
    EXPECT_EQ(standard->alloc(), nullptr) << "it has no element size";
}

TEST(MemMgrPtr, owns_its_manager) {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(16, 0, 0, 8));
    EXPECT_NE(manager->alloc(), nullptr);
    MemMgr* const plain = manager;
    EXPECT_NE(plain, nullptr);
    MemMgrPtr const none;
    EXPECT_EQ(static_cast<MemMgr*>(none), nullptr);
    MemMgrPtr const converted = MemMgr::makeStack(64, nullptr);
    EXPECT_NE(converted->alloc(1), nullptr);
}
