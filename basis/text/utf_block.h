/// \file
/// Sixteen bytes of text at a time, for the conversions between UTF-8 and UTF-16.

#ifndef BASIS_TEXT_UTF_BLOCK_H
#define BASIS_TEXT_UTF_BLOCK_H

#include "basis/ground/wide_loads.h"
#include "zor_basis/wide_char.h"

#include <cstdint>

#if ZB_VECTORS

namespace ZOR_Basis::Utf {

inline constexpr std::uint64_t BLOCK_BYTES = 16;
inline constexpr std::uint64_t BLOCK_UNITS = BLOCK_BYTES / sizeof(WChar);

using detail::bitsOf;
using detail::hasZero;
using detail::load16;
using detail::load32;
using detail::store16;
using detail::store32;
using detail::store8;
using detail::zeroBytes;
using detail::zerosIn;

/// The sum of the sixteen bytes.
inline std::uint64_t sumOfBytes(__m128i block) {
    __m128i const halves = _mm_sad_epu8(block, _mm_setzero_si128());
    return static_cast<std::uint64_t>(_mm_cvtsi128_si64(halves)) +
           static_cast<std::uint64_t>(_mm_cvtsi128_si64(_mm_unpackhi_epi64(halves, halves)));
}

/// The last `left` bytes of a block, moved to its front; zeros behind them.
ZB_SSSE3 inline __m128i movedToFront(__m128i block, std::uint64_t left) {
    alignas(BLOCK_BYTES) static constexpr std::int8_t PLACES[2 * BLOCK_BYTES] = {
        0,  1,  2,  3,  4,  5,  6,  7,  8,  9,  10, 11, 12, 13, 14, 15, //
        -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1};
    return _mm_shuffle_epi8(block, load16(PLACES + BLOCK_BYTES - left));
}

} // namespace ZOR_Basis::Utf

#endif

#endif
