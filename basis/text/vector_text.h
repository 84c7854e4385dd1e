/// \file
/// Narrow text in vectors, for copying and comparing without a call of the runtime.
///
/// The text may end before its given length, with nothing readable behind its terminator. So a vector is read only
/// where it lies in the page of its first byte, which is readable, and what does not is left to the runtime. Texts of
/// up to 64 bytes are read by vectors that overlap each other; they never reach beyond the given length.

#ifndef BASIS_TEXT_VECTOR_TEXT_H
#define BASIS_TEXT_VECTOR_TEXT_H

#include "basis/ground/wide_loads.h"

#include <cstdint>

// A sanitizer that checks addresses has to see every single byte.
#define ZB_VECTOR_TEXT (ZB_VECTORS && !ZB_ADDRESS_SANITIZER)

// Without optimisation the longer vectors would lie on the stack, which not every compiler aligns for them.
#if ZB_VECTOR_TEXT && defined(__GNUC__) && defined(__OPTIMIZE__)
#define ZB_WIDE_VECTOR_TEXT 1
#else
#define ZB_WIDE_VECTOR_TEXT 0
#endif

#if ZB_VECTOR_TEXT

namespace ZOR_Basis::detail {

constexpr std::uint64_t PAGE_BYTES = 4096;

/// Whether so many bytes, at most a page, surely lie in the page of the first one. Never for null.
inline bool inOnePage(void const* text, std::uint64_t length) noexcept {
    return length < PAGE_BYTES &&
           ((reinterpret_cast<std::uintptr_t>(text) - 1) & (PAGE_BYTES - 1)) < PAGE_BYTES - length;
}

} // namespace ZOR_Basis::detail

#endif

#endif
