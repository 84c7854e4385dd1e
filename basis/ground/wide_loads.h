/// \file
/// Loads, stores and tests for zeros of vectors of 32 bytes, at any alignment, for functions that carry the
/// target.

#ifndef BASIS_GROUND_WIDE_LOADS_H
#define BASIS_GROUND_WIDE_LOADS_H

#include "zor_basis/ground/loads.h"

#include <cstdint>

#if ZB_VECTORS

#include <immintrin.h>

namespace ZOR_Basis::detail {

ZB_AVX2 ZB_INLINE __m256i load32(void const* from) noexcept {
    return _mm256_loadu_si256(static_cast<__m256i const*>(from));
}
ZB_AVX2 ZB_INLINE void store32(void* to, __m256i bytes) noexcept {
    _mm256_storeu_si256(static_cast<__m256i*>(to), bytes);
}
/// One bit for each zero byte.
ZB_AVX2 ZB_INLINE unsigned zerosIn(__m256i bytes) noexcept {
    return static_cast<unsigned>(_mm256_movemask_epi8(_mm256_cmpeq_epi8(bytes, _mm256_setzero_si256())));
}
ZB_AVX2 ZB_INLINE bool hasZero(__m256i bytes) noexcept { return zerosIn(bytes) != 0; }

} // namespace ZOR_Basis::detail

#endif

#endif
