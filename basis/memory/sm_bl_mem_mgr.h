/// \file
/// `SmBlMemMgr`: elements of one size, carved from chunks.

#ifndef BASIS_MEMORY_SM_BL_MEM_MGR_H
#define BASIS_MEMORY_SM_BL_MEM_MGR_H

#include "basis/memory/chunk.h"
#include "zor_basis/memory/mem_mgr.h"

namespace ZOR_Basis {

class SmBlMemMgr final : public MemMgr {
public:
    SmBlMemMgr(std::uint64_t elemSize, std::uint64_t count, std::uint64_t maxCount, std::uint64_t align);

    void* alloc(std::uint64_t size) override;
    void* alloc() override;
    void free(void* p, std::uint64_t size) override;
    void free(void* p) override;

    /// Whether the chunks, the place in the current one and all freed elements agree.
    /// \cost a walk over all of them
    bool isConsistent() const;
    std::uint64_t chunkCount() const { return chunks_.size(); }
    /// Bytes of the chunk that elements are carved from.
    /// \pre there is one
    std::uint64_t chunkSize() const { return chunks_.first()->value.size; }

private:
    bool hasRoom() const { return static_cast<std::uint64_t>(top_ - base_) >= elemSize_; }
    void* carve() { return top_ -= elemSize_; }
    void* carveFromNewChunk();
    bool grow();
    std::uint64_t nextChunkSize() const;
    bool isElement(char const* p) const;

    Chunks chunks_;
    Chunks::Unit* pending_ = nullptr;
    char* freeList_ = nullptr;
    std::uint64_t elemSize_;
    char* top_ = nullptr;
    char* base_ = nullptr;
    std::uint64_t firstChunk_;
    std::uint64_t maxChunk_;
    std::uint64_t align_;
};

} // namespace ZOR_Basis

#endif
