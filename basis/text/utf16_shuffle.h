/// \file
/// A block of UTF-16 becomes UTF-8 of one or two bytes a unit, or of three: with SSSE3. Without it, characters beyond
/// ASCII are taken by themselves.

#ifndef BASIS_TEXT_UTF16_SHUFFLE_H
#define BASIS_TEXT_UTF16_SHUFFLE_H

#include "basis/text/utf16_block.h"

#include <array>

namespace ZOR_Basis::Utf {

constexpr Selection SHORTENED_UNITS = makeSelection(1, 2);

/// Stores a block of units up to 0x7FF, each as one byte or two.
/// \return the bytes; 0 if there are greater units
ZB_SSSE3 inline unsigned storeMixedBlock(__m128i block, char* out) {
    if (bitsOf(without(block, 0xF800)) != 0xFFFF) return 0;
    __m128i const ascii = without(block, 0xFF80);
    __m128i const lead = _mm_srli_epi16(block, 6);
    __m128i const continuation = _mm_slli_epi16(_mm_and_si128(block, units(0x3F)), 8);
    __m128i const two = _mm_or_si128(_mm_or_si128(lead, continuation), units(0x80C0));
    __m128i const bytes = _mm_or_si128(_mm_and_si128(ascii, block), _mm_andnot_si128(ascii, two));
    return storeSelected(out, bytes, bitsOf(_mm_packs_epi16(ascii, ascii)) & 0xFF, SHORTENED_UNITS);
}

inline constexpr std::uint64_t LONG_BLOCK_BYTES = 3 * BLOCK_UNITS;
inline constexpr std::uint64_t LONG_BLOCK_ROOM = LONG_BLOCK_BYTES + 4; // what is stored beyond the block

/// Stores a block of units of three bytes each.
/// \return whether it is one
ZB_SSSE3 inline bool storeLongBlock(__m128i block, char* out) {
    __m128i const high = _mm_and_si128(block, units(0xF800));
    if (bitsOf(_mm_or_si128(zeroUnits(high), _mm_cmpeq_epi16(high, units(0xD800)))) != 0) return false;
    __m128i const first = _mm_srli_epi16(block, 12);
    __m128i const second = _mm_and_si128(_mm_slli_epi16(block, 2), units(0x3F00));
    __m128i const front = _mm_or_si128(_mm_or_si128(first, second), units(0x80E0));
    __m128i const last = _mm_or_si128(_mm_and_si128(block, units(0x3F)), units(0x80));
    // Of each character's four bytes the last one goes.
    __m128i const kept = _mm_setr_epi8(0, 1, 2, 4, 5, 6, 8, 9, 10, 12, 13, 14, -1, -1, -1, -1);
    store16(out, _mm_shuffle_epi8(_mm_unpacklo_epi16(front, last), kept));
    store16(out + LONG_BLOCK_BYTES / 2, _mm_shuffle_epi8(_mm_unpackhi_epi16(front, last), kept));
    return true;
}

/// Where the bytes of a block come from that is moved to its front; zeros behind them.
constexpr auto PLACES_FROM_THE_END = [] {
    std::array<std::uint8_t, 2 * BLOCK_BYTES> places{};
    for (unsigned i = 0; i < places.size(); ++i) places[i] = static_cast<std::uint8_t>(i < BLOCK_BYTES ? i : 0x80);
    return places;
}();

/// A block's last `left` units, moved to its front; zeros behind them.
ZB_SSSE3 inline __m128i movedToFront(__m128i block, std::uint64_t left) {
    return _mm_shuffle_epi8(block, load16(PLACES_FROM_THE_END.data() + BLOCK_BYTES - sizeof(WChar) * left));
}

struct WithShuffle {
    ZB_SSSE3 static unsigned storeMixed(__m128i block, char* out) { return storeMixedBlock(block, out); }
    ZB_SSSE3 static bool storeLong(__m128i block, char* out) { return storeLongBlock(block, out); }
    ZB_SSSE3 static __m128i lastOf(__m128i block, std::uint64_t left) { return movedToFront(block, left); }
};
struct WithoutShuffle {
    ZB_INLINE static unsigned storeMixed(__m128i, char*) { return 0; }
    ZB_INLINE static bool storeLong(__m128i, char*) { return false; }
    ZB_INLINE static __m128i lastOf(__m128i block, std::uint64_t left) {
        WChar window[2 * BLOCK_UNITS] = {};
        store16(window, block);
        return load16(window + BLOCK_UNITS - left);
    }
};

} // namespace ZOR_Basis::Utf

#endif
