/// \file
/// Eight units of UTF-16 become UTF-8 in one step, whatever lengths their characters have. Needs SSSE3.
///
/// Each unit becomes up to three bytes in a lane of four, each half of a surrogate pair two; then a shuffle that is
/// looked up by the lengths drops the bytes between them.

#ifndef BASIS_TEXT_UTF16_BLOCK_H
#define BASIS_TEXT_UTF16_BLOCK_H

#include "basis/text/utf_block.h"

#include <array>
#include <cstdint>

#if ZB_VECTORS

namespace ZOR_Basis::Utf {

/// The most bytes that storing a block touches: its first half may have 12, and the second one stores 16.
inline constexpr std::uint64_t BLOCK_ROOM = 12 + BLOCK_BYTES;

inline __m128i eachUnit(int value) { return _mm_set1_epi16(static_cast<short>(value)); }
inline __m128i bitsOfUnits(__m128i block, int bits) { return _mm_and_si128(block, eachUnit(bits)); }
inline __m128i zeroUnits(__m128i block) { return _mm_cmpeq_epi16(block, _mm_setzero_si128()); }

/// All ones in each unit that has none of the given bits.
inline __m128i without(__m128i block, int bits) { return zeroUnits(bitsOfUnits(block, bits)); }
/// Saturated sums have the highest bit where a unit is above U+007F.
inline bool isAscii(__m128i block) { return (bitsOf(_mm_adds_epu16(block, eachUnit(0x7F80))) & 0xAAAA) == 0; }

/// All ones in each unit whose upper bits are as given.
inline __m128i withUpper(__m128i block, int mask, int upper) {
    return _mm_cmpeq_epi16(bitsOfUnits(block, mask), eachUnit(upper));
}

inline __m128i choose(__m128i condition, __m128i ifTrue, __m128i ifFalse) {
    return _mm_or_si128(_mm_and_si128(condition, ifTrue), _mm_andnot_si128(condition, ifFalse));
}
inline __m128i anyOf(__m128i a, __m128i b, __m128i c) { return _mm_or_si128(_mm_or_si128(a, b), c); }

/// How many bytes each of eight units makes, outside surrogate pairs.
struct Lengths {
    ZB_INLINE explicit Lengths(__m128i block) : one(without(block, 0xFF80)), oneOrTwo(without(block, 0xF800)) {}

    /// A bit for each unit: of `one` in the lower byte, of `oneOrTwo` in the upper one.
    ZB_INLINE unsigned bits() const { return bitsOf(_mm_packs_epi16(one, oneOrTwo)); }

    __m128i one;      ///< all ones where there is but one byte
    __m128i oneOrTwo; ///< all ones where there is no third byte
};
inline bool areAllOne(unsigned bitsOfLengths) { return bitsOfLengths == 0xFFFF; }
inline bool areAllOneOrTwo(unsigned bitsOfLengths) { return bitsOfLengths >= 0xFF00; }

/// Each unit as two bytes.
/// \pre it is U+0080 to U+07FF
inline __m128i twoBytes(__m128i block) {
    return anyOf(_mm_srli_epi16(block, 6), _mm_slli_epi16(bitsOfUnits(block, 0x3F), 8), eachUnit(0x80C0));
}

/// Eight units, each as its bytes.
struct Utf8Lanes {
    __m128i front; ///< the first byte, and the second one above it
    __m128i third;
    Lengths lengths;
};

/// \pre there are no surrogates
inline Utf8Lanes lanesOf(__m128i block, Lengths const& lengths) {
    __m128i const three =
        anyOf(_mm_srli_epi16(block, 12), _mm_slli_epi16(bitsOfUnits(block, 0xFC0), 2), eachUnit(0x80E0));
    return {choose(lengths.one, block, choose(lengths.oneOrTwo, twoBytes(block), three)),
            _mm_or_si128(bitsOfUnits(block, 0x3F), eachUnit(0x80)), lengths};
}

/// The surrogate pairs that lie in a block. All ones in their high halves, and in their low ones.
struct Pairs {
    explicit Pairs(__m128i block) {
        __m128i const anyHigh = withUpper(block, 0xFC00, 0xD800);
        __m128i const anyLow = withUpper(block, 0xFC00, 0xDC00);
        high = _mm_and_si128(anyHigh, _mm_srli_si128(anyLow, sizeof(WChar)));
        low = _mm_and_si128(anyLow, _mm_slli_si128(anyHigh, sizeof(WChar)));
    }
    __m128i both() const { return _mm_or_si128(high, low); }

    __m128i high;
    __m128i low;
};

/// The same with surrogates. A character above U+FFFF has its upper eleven bits in the high half of its pair, which
/// makes two bytes and leaves its last two bits to the third byte, that of the low half.
inline Utf8Lanes lanesWithPairsOf(__m128i block, __m128i surrogates, Lengths const& lengths) {
    Pairs const pairs(block);
    __m128i const unpaired = _mm_andnot_si128(pairs.both(), surrogates);
    Utf8Lanes lanes = lanesOf(choose(unpaired, eachUnit(0xFFFD), block), lengths);

    __m128i const upper = _mm_add_epi16(bitsOfUnits(block, 0x3FF), eachUnit(0x40));
    __m128i const high = anyOf(_mm_srli_epi16(upper, 8), _mm_slli_epi16(bitsOfUnits(upper, 0xFC), 6), eachUnit(0x80F0));
    __m128i const fromHigh = _mm_slli_epi16(bitsOfUnits(_mm_slli_si128(block, sizeof(WChar)), 0x03), 4);
    __m128i const low = anyOf(_mm_or_si128(fromHigh, bitsOfUnits(_mm_srli_epi16(block, 6), 0x0F)),
                              _mm_slli_epi16(bitsOfUnits(block, 0x3F), 8), eachUnit(0x8080));
    lanes.front = choose(pairs.high, high, choose(pairs.low, low, lanes.front));
    lanes.lengths.oneOrTwo = _mm_or_si128(lengths.oneOrTwo, pairs.both());
    return lanes;
}

/// Which bytes of a vector stay, by a choice of eight bits, and how many they are.
struct KeptBytes {
    std::array<std::array<std::uint8_t, BLOCK_BYTES>, 256> places;
    std::array<std::uint8_t, 256> sizes;

    constexpr void keep(unsigned choice, unsigned first, unsigned count) {
        for (unsigned i = 0; i < count; ++i) places[choice][sizes[choice]++] = static_cast<std::uint8_t>(first + i);
    }
};

/// Of eight lanes of two bytes, one stays where the bit is set.
inline constexpr KeptBytes KEPT_OF_TWO = [] {
    KeptBytes kept{};
    for (unsigned choice = 0; choice < 256; ++choice) {
        for (unsigned lane = 0; lane < 8; ++lane) kept.keep(choice, 2 * lane, (choice >> lane & 1) != 0 ? 1 : 2);
    }
    return kept;
}();

/// Of four lanes of up to three bytes. The lower four bits of the choice are those of `one`, the upper ones those of
/// `oneOrTwo`; a lane of one byte that is neither is dropped.
inline constexpr KeptBytes KEPT_OF_THREE = [] {
    KeptBytes kept{};
    for (unsigned choice = 0; choice < 256; ++choice) {
        for (unsigned lane = 0; lane < 4; ++lane) {
            bool const one = (choice >> lane & 1) != 0;
            bool const oneOrTwo = (choice >> lane & 16) != 0;
            kept.keep(choice, 4 * lane, one ? (oneOrTwo ? 1 : 0) : (oneOrTwo ? 2 : 3));
        }
    }
    return kept;
}();

ZB_SSSE3 inline std::uint64_t storeKept(__m128i bytes, unsigned choice, KeptBytes const& kept, char* out) {
    store16(out, _mm_shuffle_epi8(bytes, load16(kept.places[choice].data())));
    return kept.sizes[choice];
}

/// Stores units up to U+07FF.
/// \param one  a bit for each unit of one byte
ZB_SSSE3 inline std::uint64_t storeShort(__m128i block, Lengths const& lengths, unsigned one, char* out) {
    return storeKept(choose(lengths.one, block, twoBytes(block)), one, KEPT_OF_TWO, out);
}

/// Stores the bytes of the first `count` units.
/// \return how many
ZB_SSSE3 inline std::uint64_t storeLong(Utf8Lanes const& lanes, unsigned bitsOfLengths, unsigned count, char* out) {
    unsigned const taken = (1U << count) - 1;
    unsigned const one = bitsOfLengths | (0xFF & ~taken);
    unsigned const oneOrTwo = bitsOfLengths >> 8 & taken;
    std::uint64_t const size = storeKept(_mm_unpacklo_epi16(lanes.front, lanes.third),
                                         (one & 0xF) | (oneOrTwo << 4 & 0xF0), KEPT_OF_THREE, out);
    return size + storeKept(_mm_unpackhi_epi16(lanes.front, lanes.third), (one >> 4 & 0xF) | (oneOrTwo & 0xF0),
                            KEPT_OF_THREE, out + size);
}

struct Taken {
    std::uint64_t units;
    std::uint64_t bytes;
};

/// Converts the first `count` units of a block, the others being zeros; of eight not a pair's first half at the end.
ZB_SSSE3 ZB_INLINE Taken storeUtf8(__m128i block, Lengths const& lengths, unsigned bitsOfLengths, unsigned count,
                                   char* out) {
    if (areAllOneOrTwo(bitsOfLengths)) {
        std::uint64_t const behind = BLOCK_UNITS - count;
        return {count, storeShort(block, lengths, bitsOfLengths & 0xFF, out) - behind};
    }
    __m128i const surrogates = withUpper(block, 0xF800, 0xD800);
    if (bitsOf(surrogates) == 0) return {count, storeLong(lanesOf(block, lengths), bitsOfLengths, count, out)};
    bool const isCut = (_mm_extract_epi16(block, 7) & 0xFC00) == 0xD800;
    unsigned const taken = count - (isCut ? 1 : 0);
    Utf8Lanes const lanes = lanesWithPairsOf(block, surrogates, lengths);
    return {taken, storeLong(lanes, lanes.lengths.bits(), taken, out)};
}

} // namespace ZOR_Basis::Utf

#endif

#endif
