/// \file
/// Where a line ends.

#ifndef BASIS_SYSTEM_LINE_LENGTH_H
#define BASIS_SYSTEM_LINE_LENGTH_H

#include "zor_basis/ground/loads.h"

#include <bit>
#include <cstdint>

namespace ZOR_Basis {

inline bool endsLine(char c) { return c == '\n' || c == '\r' || c == '\0'; }

#if ZB_VECTORS

/// One bit for each of 16 bytes: whether it ends a line.
inline std::uint64_t lineEndsIn16(char const* text) {
    __m128i const bytes = detail::load16(text);
    __m128i const lineFeeds = _mm_cmpeq_epi8(bytes, _mm_set1_epi8('\n'));
    __m128i const carriageReturns = _mm_cmpeq_epi8(bytes, _mm_set1_epi8('\r'));
    return detail::bitsOf(_mm_or_si128(_mm_or_si128(lineFeeds, carriageReturns), detail::zeroBytes(bytes)));
}

/// The same for 64 bytes. None of those that end a line is above a carriage return, and mostly nothing else is below.
inline std::uint64_t lineEndsIn64(char const* text) {
    using detail::load16;
    __m128i const lower = _mm_min_epu8(load16(text), load16(text + 16));
    __m128i const upper = _mm_min_epu8(load16(text + 32), load16(text + 48));
    __m128i const lowest = _mm_min_epu8(lower, upper);
    __m128i const capped = _mm_min_epu8(lowest, _mm_set1_epi8('\r'));
    if (detail::bitsOf(_mm_cmpeq_epi8(capped, lowest)) == 0) return 0;
    return lineEndsIn16(text) | lineEndsIn16(text + 16) << 16 | lineEndsIn16(text + 32) << 32 |
           lineEndsIn16(text + 48) << 48;
}

#endif

/// The bytes before the first line feed, carriage return or zero, at most `limit`; nothing behind the limit is read.
inline std::uint64_t lengthOfLine(char const* text, std::uint64_t limit) {
    std::uint64_t length = 0;
#if ZB_VECTORS
    for (; limit - length >= 64; length += 64) {
        if (std::uint64_t const ends = lineEndsIn64(text + length))
            return length + static_cast<unsigned>(std::countr_zero(ends));
    }
    for (; limit - length >= 16; length += 16) {
        if (std::uint64_t const ends = lineEndsIn16(text + length))
            return length + static_cast<unsigned>(std::countr_zero(ends));
    }
#endif
    while (length < limit && !endsLine(text[length])) ++length;
    return length;
}

} // namespace ZOR_Basis

#endif
