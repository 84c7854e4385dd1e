#include "basis/memory/stack_mem_mgr.h"

namespace ZOR_Basis {

StackMemMgr::StackMemMgr(std::uint64_t blockSize, void* buffer) : blockSize_(blockSize) {
    if (buffer != nullptr) use(borrowChunk(blockSize, buffer));
}

void* StackMemMgr::alloc(std::uint64_t) {
    // kept memory-02: callers take the end as a mark, and put nothing there.
    if (end_ == nullptr) use(makeChunk(blockSize_));
    return end_;
}

void StackMemMgr::free(void*) {}

void StackMemMgr::use(Chunks::Unit* block) {
    if (block == nullptr) return;
    start_ = block->value.data;
    end_ = start_ + blockSize_;
    blocks_.insertFront(block);
}

} // namespace ZOR_Basis
