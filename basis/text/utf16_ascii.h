/// \file
/// ASCII at the front of a text of UTF-16: by AVX2 where the text is long, then by blocks.

#ifndef BASIS_TEXT_UTF16_ASCII_H
#define BASIS_TEXT_UTF16_ASCII_H

#include "basis/text/utf16_block.h"
#include "basis/text/utf16_progress.h"

#include <algorithm>

namespace ZOR_Basis::Utf {

ZB_INLINE void takeAsciiBlocks(Progress& progress) {
    constexpr std::uint64_t STEP = 2 * BLOCK_UNITS;
    __m128i least = _mm_set1_epi8(-1);
    for (std::uint64_t steps = std::min(progress.left(), progress.room()) / STEP; steps > 0; --steps) {
        __m128i const low = load16(progress.text);
        __m128i const high = load16(progress.text + BLOCK_UNITS);
        if (!isAscii(_mm_or_si128(low, high))) break;
        __m128i const bytes = _mm_packus_epi16(low, high);
        least = _mm_min_epu8(least, bytes);
        store16(progress.out, bytes);
        progress.advance(STEP, STEP);
    }
    progress.hasZero |= hasZero(least);
}

struct Run {
    std::uint64_t units;
    bool hasZero;
};

/// ASCII from the front of `most` units, by blocks of twice the size.
ZB_AVX2 inline Run takeWideAscii(WChar const* text, char* out, std::uint64_t most) {
    constexpr std::uint64_t STEP = 4 * BLOCK_UNITS;
    __m256i const beyondAscii = _mm256_set1_epi16(static_cast<short>(0xFF80));
    __m256i least = _mm256_set1_epi8(-1);
    std::uint64_t done = 0;
    for (; done + STEP <= most; done += STEP) {
        __m256i const low = load32(text + done);
        __m256i const high = load32(text + done + STEP / 2);
        if (_mm256_testz_si256(_mm256_or_si256(low, high), beyondAscii) == 0) break;
        // Packing takes the halves of both by turns.
        __m256i const bytes = _mm256_permute4x64_epi64(_mm256_packus_epi16(low, high), _MM_SHUFFLE(3, 1, 2, 0));
        least = _mm256_min_epu8(least, bytes);
        store32(out + done, bytes);
    }
    return {done, hasZero(least)};
}

/// Takes all of the text, if it is ASCII; else as much of its front as goes easily.
/// \pre nothing has been taken; at least a block
ZB_INLINE void takeAsciiText(Progress& progress) {
    if (progress.left() >= LEAST_WIDE_UNITS && ZB_HAS_AVX2) {
        auto const [units, hasZero] =
            takeWideAscii(progress.text, progress.out, std::min(progress.left(), progress.room()));
        progress.hasZero = hasZero;
        progress.advance(units, units);
    }
    takeAsciiBlocks(progress);
    // Two blocks reach from the end back to what has been taken; some of that is stored once more, where it is already.
    std::uint64_t const left = progress.left();
    if (left == 0 || left >= 2 * BLOCK_UNITS || progress.room() < left) return;
    std::uint64_t const back = std::min(progress.done() + left, 2 * BLOCK_UNITS);
    __m128i const low = load16(progress.end - back);
    __m128i const high = load16(progress.end - BLOCK_UNITS);
    if (!isAscii(_mm_or_si128(low, high))) return;
    char* const end = progress.out + left;
    store8(end - back, packed(low));
    store8(end - BLOCK_UNITS, packed(high));
    progress.hasZero |= bitsOf(_mm_or_si128(zeroUnits(low), zeroUnits(high))) != 0;
    progress.advance(left, left);
}

} // namespace ZOR_Basis::Utf

#endif
