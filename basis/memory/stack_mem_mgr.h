/// \file
/// `StackMemMgr`: hands out the end of a block.

#ifndef BASIS_MEMORY_STACK_MEM_MGR_H
#define BASIS_MEMORY_STACK_MEM_MGR_H

#include "basis/memory/chunk.h"
#include "zor_basis/memory/mem_mgr.h"

namespace ZOR_Basis {

class StackMemMgr final : public MemMgr {
public:
    StackMemMgr(std::uint64_t blockSize, void* buffer);

    using MemMgr::alloc;
    using MemMgr::free;
    void* alloc(std::uint64_t size) override;
    void free(void* p) override;

private:
    void use(Chunks::Unit* block);

    Chunks blocks_;
    char* end_ = nullptr;
    char* start_ = nullptr;
    std::uint64_t blockSize_;
};

} // namespace ZOR_Basis

#endif
