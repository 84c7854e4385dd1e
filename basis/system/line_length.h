/// \file
/// Where a line ends.

#ifndef BASIS_SYSTEM_LINE_LENGTH_H
#define BASIS_SYSTEM_LINE_LENGTH_H

#include "zor_basis/text/word_ops.h"

#include <bit>
#include <cstdint>

namespace ZOR_Basis {

inline bool endsLine(char c) { return c == '\n' || c == '\r' || c == '\0'; }

/// The bytes before the first line feed, carriage return or zero, at most `limit`; none behind those is read.
inline std::uint64_t lengthOfLine(char const* text, std::uint64_t limit) {
    std::uint64_t length = 0;
#if ZB_VECTORS
    __m128i const lineFeed = _mm_set1_epi8('\n');
    __m128i const carriageReturn = _mm_set1_epi8('\r');
    for (; limit - length >= sizeof(__m128i); length += sizeof(__m128i)) {
        __m128i const bytes = _mm_loadu_si128(reinterpret_cast<__m128i const*>(text + length));
        __m128i const lineEnds = _mm_or_si128(_mm_cmpeq_epi8(bytes, lineFeed), _mm_cmpeq_epi8(bytes, carriageReturn));
        __m128i const ends = _mm_or_si128(lineEnds, _mm_cmpeq_epi8(bytes, _mm_setzero_si128()));
        auto const found = static_cast<unsigned>(_mm_movemask_epi8(ends));
        if (found != 0) return length + static_cast<unsigned>(std::countr_zero(found));
    }
#endif
    while (length < limit && !endsLine(text[length])) ++length;
    return length;
}

} // namespace ZOR_Basis

#endif
