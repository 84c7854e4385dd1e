/// \file
/// Fills memory with zeros although it is not read afterwards.

#ifndef BASIS_TEXT_WIPE_H
#define BASIS_TEXT_WIPE_H

#include <cstdint>
#include <cstring>

namespace ZOR_Basis {

/// Fills memory with zeros. No optimiser can drop it: what the pointer leads to is only known when it is called.
inline void wipe(void* memory, std::uint64_t n) {
    static void* (*volatile const fill)(void*, int, std::size_t) = std::memset;
    if (memory != nullptr) fill(memory, 0, n);
}

} // namespace ZOR_Basis

#endif
