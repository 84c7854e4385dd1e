/// \file
/// Loads, stores and tests for zeros of vectors of 32 and 64 bytes, at any alignment, for functions that carry the
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
ZB_AVX2 ZB_INLINE bool hasZero(__m256i bytes) noexcept {
    return _mm256_movemask_epi8(_mm256_cmpeq_epi8(bytes, _mm256_setzero_si256())) != 0;
}

ZB_AVX512 ZB_INLINE __m512i load64(void const* from) noexcept { return _mm512_loadu_si512(from); }
/// The first `count` of 64 bytes, zeros behind them; what is behind is not read.
/// \pre count is 1 to 64
ZB_AVX512 ZB_INLINE __m512i loadFirst(void const* from, std::uint64_t count) noexcept {
    return _mm512_maskz_loadu_epi8(~std::uint64_t{0} >> (64 - count), from);
}
/// One bit for each zero byte.
ZB_AVX512 ZB_INLINE std::uint64_t zerosIn(__m512i bytes) noexcept { return _mm512_testn_epi8_mask(bytes, bytes); }

} // namespace ZOR_Basis::detail

#endif

#endif
