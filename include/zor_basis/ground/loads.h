/// \file
/// Loads, stores and tests for zeros, of words and of vectors of 16 bytes, at any alignment, for the library's own
/// headers. basis/ground/wide_loads.h has the same for longer vectors.

#ifndef ZOR_BASIS_GROUND_LOADS_H
#define ZOR_BASIS_GROUND_LOADS_H

#include "zor_basis/ground/compiler.h"

#include <cstdint>
#include <cstring>

#if ZB_VECTORS
#include <emmintrin.h>
#endif

namespace ZOR_Basis::detail {

template <class Word>
ZB_INLINE Word loadWord(void const* from) noexcept {
    Word word;
    std::memcpy(&word, from, sizeof word);
    return word;
}

template <class Word>
ZB_INLINE void storeWord(void* to, Word word) noexcept {
    std::memcpy(to, &word, sizeof word);
}

/// The highest bit of the first zero byte and of some behind it; 0 where there is none.
ZB_INLINE std::uint64_t zerosIn(std::uint64_t word) noexcept {
    return (word - 0x0101010101010101U) & ~word & 0x8080808080808080U;
}
ZB_INLINE bool hasZero(std::uint64_t word) noexcept { return zerosIn(word) != 0; }

#if ZB_VECTORS

/// 8 bytes in the lower half, zeros in the upper one.
ZB_INLINE __m128i load8(void const* from) noexcept { return _mm_loadl_epi64(static_cast<__m128i const*>(from)); }
ZB_INLINE __m128i load16(void const* from) noexcept { return _mm_loadu_si128(static_cast<__m128i const*>(from)); }

/// The lower half.
ZB_INLINE void store8(void* to, __m128i bytes) noexcept { _mm_storel_epi64(static_cast<__m128i*>(to), bytes); }
ZB_INLINE void store16(void* to, __m128i bytes) noexcept { _mm_storeu_si128(static_cast<__m128i*>(to), bytes); }

/// The highest bit of each byte.
ZB_INLINE unsigned bitsOf(__m128i bytes) noexcept { return static_cast<unsigned>(_mm_movemask_epi8(bytes)); }

/// All ones in each byte that is zero, and the same with one bit a byte.
ZB_INLINE __m128i zeroBytes(__m128i bytes) noexcept { return _mm_cmpeq_epi8(bytes, _mm_setzero_si128()); }
ZB_INLINE unsigned zerosIn(__m128i bytes) noexcept { return bitsOf(zeroBytes(bytes)); }
ZB_INLINE bool hasZero(__m128i bytes) noexcept { return zerosIn(bytes) != 0; }

#endif

} // namespace ZOR_Basis::detail

#endif
