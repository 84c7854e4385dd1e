// The factories, apart from the interface that the managers are made of.

#include "zor_basis/memory/mem_mgr.h"

#include "basis/memory/sm_bl_mem_mgr.h"
#include "basis/memory/stack_mem_mgr.h"

#include <new>

namespace ZOR_Basis {

MemMgr* MemMgr::makeSmlBlk(std::uint64_t elemSize, std::uint64_t count, std::uint64_t maxCount, std::uint64_t align) {
    return new (std::nothrow) SmBlMemMgr(elemSize, count, maxCount, align);
}

MemMgr* MemMgr::makeStack(std::uint64_t blockSize, void* buffer) {
    return new (std::nothrow) StackMemMgr(blockSize, buffer);
}

} // namespace ZOR_Basis
