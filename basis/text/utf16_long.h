/// \file
/// Runs of longer characters: of three bytes, as in Asian texts, and of four, from surrogate pairs.

#ifndef BASIS_TEXT_UTF16_LONG_H
#define BASIS_TEXT_UTF16_LONG_H

#include "basis/text/utf.h"
#include "basis/text/utf16_progress.h"
#include "basis/text/utf16_shuffle.h"

namespace ZOR_Basis::Utf {

inline constexpr std::uint64_t LONGEST_CHARACTER = 4;

/// The three bytes of a unit above 0x7FF, the first one lowest.
inline std::uint32_t threeBytes(std::uint32_t unit) {
    return 0x8080E0u | unit >> 12 | (unit << 2 & 0x3F00) | (unit & 0x3F) << 16;
}

/// The four bytes of each surrogate pair in a word of one or two of them, the first one lowest.
template <class Word>
Word fourBytes(Word pairs) {
    constexpr Word EACH = static_cast<Word>(0x00000001'00000001);
    Word const high = (pairs & 0x3FF * EACH) + 0x40 * EACH; // the character without its lower ten bits
    Word const low = pairs >> 16 & 0x3FF * EACH;
    return 0x808080F0 * EACH | (high >> 8 & 0x07 * EACH) | (high & 0xFC * EACH) << 6 | (high & 0x03 * EACH) << 20 |
           (low & 0x3C0 * EACH) << 10 | (low & 0x3F * EACH) << 24;
}

/// Whether a word consists of surrogate pairs.
template <class Word>
bool arePairs(Word units) {
    constexpr Word EACH = static_cast<Word>(0x00000001'00000001);
    return (units & 0xFC00FC00 * EACH) == 0xDC00D800 * EACH;
}

inline __m128i eachLane(std::uint32_t value) { return _mm_set1_epi32(static_cast<int>(value)); }
inline __m128i lanesOf(__m128i block, std::uint32_t bits) { return _mm_and_si128(block, eachLane(bits)); }

/// The same of a block of four pairs. Never inlined: its many constants would take the registers of the other steps,
/// and mixed texts would need 5 % more instructions.
ZB_COLD inline __m128i fourBytes(__m128i pairs) {
    __m128i const high = _mm_add_epi32(lanesOf(pairs, 0x3FF), eachLane(0x40));
    __m128i const low = _mm_srli_epi32(pairs, 16);
    __m128i const first = lanesOf(_mm_srli_epi32(high, 8), 0x07);
    __m128i const second = _mm_slli_epi32(lanesOf(high, 0xFC), 6);
    __m128i const third =
        _mm_or_si128(_mm_slli_epi32(lanesOf(high, 0x03), 20), _mm_slli_epi32(lanesOf(low, 0x3C0), 10));
    __m128i const fourth = _mm_slli_epi32(lanesOf(low, 0x3F), 24);
    return _mm_or_si128(_mm_or_si128(_mm_or_si128(first, second), _mm_or_si128(third, fourth)), eachLane(0x808080F0));
}

inline bool arePairs(__m128i block) {
    return bitsOf(_mm_cmpeq_epi32(lanesOf(block, 0xFC00FC00), eachLane(0xDC00D800))) == 0xFFFF;
}

template <class Shuffle>
ZB_INLINE void takeThreeByteRun(Progress& progress) {
    while (progress.left() >= BLOCK_UNITS && progress.room() >= LONG_BLOCK_ROOM &&
           Shuffle::storeLong(load16(progress.text), progress.out)) {
        progress.advance(BLOCK_UNITS, LONG_BLOCK_BYTES);
    }
    // The word that is stored is one byte longer than the character.
    while (progress.left() > 0 && progress.room() >= LONGEST_CHARACTER) {
        std::uint32_t const unit = *progress.text;
        if (unit < 0x800 || isSurrogate(unit)) return;
        storeWord(progress.out, threeBytes(unit));
        progress.advance(1, 3);
    }
}

ZB_INLINE void takePairs(Progress& progress) {
    while (progress.left() >= BLOCK_UNITS && progress.room() >= BLOCK_BYTES) {
        __m128i const block = load16(progress.text);
        if (!arePairs(block)) break;
        store16(progress.out, fourBytes(block));
        progress.advance(BLOCK_UNITS, BLOCK_BYTES);
    }
    while (progress.left() >= 4 && progress.room() >= 2 * LONGEST_CHARACTER) {
        auto const word = loadWord<std::uint64_t>(progress.text);
        if (!arePairs(word)) return;
        storeWord(progress.out, fourBytes(word));
        progress.advance(4, 2 * LONGEST_CHARACTER);
    }
}

} // namespace ZOR_Basis::Utf

#endif
