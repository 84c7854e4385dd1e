/// \file
/// Eight units of UTF-16 at a time: the tests that all steps of the conversion to UTF-8 use.

#ifndef BASIS_TEXT_UTF16_BLOCK_H
#define BASIS_TEXT_UTF16_BLOCK_H

#include "basis/text/utf_block.h"

namespace ZOR_Basis::Utf {

inline __m128i units(int value) { return _mm_set1_epi16(static_cast<short>(value)); }

inline __m128i zeroUnits(__m128i block) { return _mm_cmpeq_epi16(block, _mm_setzero_si128()); }

/// All ones in each unit that has none of the given bits.
inline __m128i without(__m128i block, int bits) { return zeroUnits(_mm_and_si128(block, units(bits))); }

inline bool isAscii(__m128i block) { return bitsOf(without(block, 0xFF80)) == 0xFFFF; }

inline __m128i packed(__m128i block) { return _mm_packus_epi16(block, block); }

} // namespace ZOR_Basis::Utf

#endif
