#include "basis/memory/node_memory.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct Node {
    int number;
    int* ends;
    ~Node() { ++*ends; }
};

/// Has room for one node and counts calls.
class OnePlace : public MemMgr {
public:
    using MemMgr::alloc;
    using MemMgr::free;
    void* alloc() override { return taken++ == 0 ? place : nullptr; }
    void free(void* p) override { given += p == place ? 1 : 100; }

    int taken = 0;
    int given = 0;
    alignas(Node) unsigned char place[sizeof(Node)];
};

} // namespace

TEST(NodeMemory, comes_from_the_heap_or_from_a_manager) {
    OnePlace manager;
    for (MemMgr* from : {static_cast<MemMgr*>(nullptr), static_cast<MemMgr*>(&manager)}) {
        int ends = 0;
        auto* const node = makeNode<Node>(from, 7, &ends);
        ASSERT_NE(node, nullptr);
        EXPECT_EQ(node->number, 7);
        EXPECT_EQ(ends, 0);
        deleteNode(from, node);
        EXPECT_EQ(ends, 1);
    }
    EXPECT_EQ(manager.taken, 1);
    EXPECT_EQ(manager.given, 1);
    int ends = 0;
    EXPECT_EQ(makeNode<Node>(&manager, 8, &ends), nullptr) << "memory is short";
    EXPECT_EQ(ends, 0);
}
