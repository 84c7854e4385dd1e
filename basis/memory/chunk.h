/// \file
/// `LB`: the record of one block of memory in a manager's list.

#ifndef BASIS_MEMORY_CHUNK_H
#define BASIS_MEMORY_CHUNK_H

#include "zor_basis/containers/sng_list.h"

#include <cstdint>
#include <cstdlib>
#include <new>

namespace ZOR_Basis {

struct LB {
    /// Memory from `malloc`, which is released with the record, or the caller's.
    static constexpr bool OWNED = true;
    static constexpr bool BORROWED = false;

    LB(std::uint64_t bytes, char* memory, bool isOwned) : size(bytes), data(memory), owned(isOwned) {}
    LB(LB const&) = delete;
    LB& operator=(LB const&) = delete;
    ~LB() {
        if (owned) std::free(data);
    }

    std::uint64_t size;
    char* data;
    bool owned;
};

using Chunks = SngList<LB>;

/// A record over memory of the caller.
/// \return null when memory runs out
inline Chunks::Unit* borrowChunk(std::uint64_t size, void* memory) {
    return new (std::nothrow) Chunks::Unit{nullptr, LB(size, static_cast<char*>(memory), LB::BORROWED)};
}

/// A record over memory of its own.
/// \return null when memory runs out
inline Chunks::Unit* makeChunk(std::uint64_t size) {
    char* const data = static_cast<char*>(std::malloc(size));
    if (data == nullptr) return nullptr;
    Chunks::Unit* const chunk = new (std::nothrow) Chunks::Unit{nullptr, LB(size, data, LB::OWNED)};
    if (chunk == nullptr) std::free(data);
    return chunk;
}

} // namespace ZOR_Basis

#endif
