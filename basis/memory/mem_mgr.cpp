#include "zor_basis/memory/mem_mgr.h"

#include "basis/memory/sm_bl_mem_mgr.h"
#include "basis/memory/stack_mem_mgr.h"

#include <cstdlib>
#include <new>

namespace ZOR_Basis {

constinit MemMgr MemMgr::_Only;

void* MemMgr::alloc(std::uint64_t size) { return std::malloc(size); }
void* MemMgr::alloc() { return nullptr; }
void MemMgr::free(void* p, std::uint64_t) { std::free(p); }
void MemMgr::free(void* p) { std::free(p); }
MemMgr::~MemMgr() = default;

MemMgr* MemMgr::makeStd() { return &_Only; }

MemMgr* MemMgr::makeSmlBlk(std::uint64_t elemSize, std::uint64_t count, std::uint64_t maxCount, std::uint64_t align) {
    return new (std::nothrow) SmBlMemMgr(elemSize, count, maxCount, align);
}

MemMgr* MemMgr::makeStack(std::uint64_t blockSize, void* buffer) {
    return new (std::nothrow) StackMemMgr(blockSize, buffer);
}

} // namespace ZOR_Basis
