#include "zor_basis/memory/mem_mgr.h"

#include <cstdlib>

namespace ZOR_Basis {

constinit MemMgr MemMgr::_Only;

void* MemMgr::alloc(std::uint64_t size) { return std::malloc(size); }
void* MemMgr::alloc() { return nullptr; }
void MemMgr::free(void* p, std::uint64_t) { std::free(p); }
void MemMgr::free(void* p) { std::free(p); }
MemMgr::~MemMgr() = default;

MemMgr* MemMgr::makeStd() { return &_Only; }

} // namespace ZOR_Basis
