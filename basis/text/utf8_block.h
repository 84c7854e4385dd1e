/// \file
/// Sixteen bytes of UTF-8 at a time, checked, and converted to UTF-16 in one step whatever lengths their characters
/// have. Needs SSSE3.
///
/// The check follows J. Keiser and D. Lemire, "Validating UTF-8 in less than one instruction per byte", 2021. A block
/// contains the last bytes of characters that began in the block before, so each byte is seen with the three in front
/// of it, and blocks do not wait for each other.

#ifndef BASIS_TEXT_UTF8_BLOCK_H
#define BASIS_TEXT_UTF8_BLOCK_H

#include "basis/text/utf_block.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <cstring>

#if ZB_VECTORS

namespace ZOR_Basis::Utf {

// ---- faults ---------------------------------------------------------------------------------------------------------

/// What is wrong with two adjacent bytes: the upper and lower half of the first one, and the upper half of the second
/// one, are each in a set of values, a bit for each.
struct PairFault {
    unsigned firstUpper;
    unsigned firstLower;
    unsigned secondUpper;
};

inline constexpr unsigned ANY = 0xFFFF;
inline constexpr unsigned CONTINUATION = 0x0F00; // 8 to B

/// The last one is no fault if the second byte is the third or fourth of its character.
inline constexpr std::array<PairFault, 8> PAIR_FAULTS = {{
    {0xF000, ANY, ANY & ~CONTINUATION}, // a lead byte, not followed by a continuation
    {0x00FF, ANY, CONTINUATION},        // a continuation behind ASCII
    {1U << 0xC, 0x0003, CONTINUATION},  // below U+0080 in two bytes
    {1U << 0xE, 1U << 0x0, 0x0300},     // below U+0800 in three bytes
    {1U << 0xE, 1U << 0xD, 0x0C00},     // a surrogate
    {1U << 0xF, 0xFFF0, 0x0E00},        // above U+10FFFF, by the second byte or by the first one
    {1U << 0xF, 0xFFE1, 1U << 0x8},     // the same, or below U+10000 in four bytes
    {CONTINUATION, ANY, CONTINUATION},  // two continuations
}};
inline constexpr int TWO_CONTINUATIONS = 0x80;

using HalfByteTable = std::array<std::uint8_t, 16>;

/// The faults that are possible with each value of one half of a byte.
constexpr HalfByteTable faultsBy(unsigned PairFault::*half) {
    HalfByteTable table{};
    for (unsigned fault = 0; fault < PAIR_FAULTS.size(); ++fault) {
        for (unsigned value = 0; value < table.size(); ++value) {
            if ((PAIR_FAULTS[fault].*half >> value & 1) != 0)
                table[value] = static_cast<std::uint8_t>(table[value] | 1U << fault);
        }
    }
    return table;
}

alignas(BLOCK_BYTES) inline constexpr HalfByteTable BY_FIRST_UPPER = faultsBy(&PairFault::firstUpper);
alignas(BLOCK_BYTES) inline constexpr HalfByteTable BY_FIRST_LOWER = faultsBy(&PairFault::firstLower);
alignas(BLOCK_BYTES) inline constexpr HalfByteTable BY_SECOND_UPPER = faultsBy(&PairFault::secondUpper);

inline __m128i eachByte(int value) { return _mm_set1_epi8(static_cast<char>(value)); }
inline __m128i upperHalves(__m128i bytes) { return _mm_and_si128(_mm_srli_epi16(bytes, 4), eachByte(0x0F)); }
inline __m128i lowerHalves(__m128i bytes) { return _mm_and_si128(bytes, eachByte(0x0F)); }

ZB_SSSE3 inline __m128i lookUp(HalfByteTable const& table, __m128i halves) {
    return _mm_shuffle_epi8(load16(table.data()), halves);
}

// ---- blocks ---------------------------------------------------------------------------------------------------------

/// A block, and the blocks of bytes that are one, two and three places in front of its bytes.
struct Utf8Block {
    ZB_SSSE3 ZB_INLINE Utf8Block(__m128i before, __m128i block)
        : bytes(block),
          back1(_mm_alignr_epi8(block, before, 15)),
          back2(_mm_alignr_epi8(block, before, 14)),
          back3(_mm_alignr_epi8(block, before, 13)) {}

    /// Not 0 in each byte that is wrong behind those in front of it.
    ZB_SSSE3 ZB_INLINE __m128i faults() const {
        __m128i const ofPair = _mm_and_si128(
            _mm_and_si128(lookUp(BY_FIRST_UPPER, upperHalves(back1)), lookUp(BY_FIRST_LOWER, lowerHalves(back1))),
            lookUp(BY_SECOND_UPPER, upperHalves(bytes)));
        // The highest bit of what is left is set behind a lead byte of three or four bytes, of four bytes.
        __m128i const isThird = _mm_subs_epu8(back2, eachByte(0xE0 - 0x80));
        __m128i const isFourth = _mm_subs_epu8(back3, eachByte(0xF0 - 0x80));
        __m128i const mayFollow = _mm_and_si128(_mm_or_si128(isThird, isFourth), eachByte(TWO_CONTINUATIONS));
        return _mm_xor_si128(mayFollow, ofPair);
    }

    /// All ones in each byte that gives a unit: the last byte of a character, and the third one of four.
    ZB_INLINE __m128i givesUnit() const {
        __m128i const isLead = _mm_subs_epu8(bytes, eachByte(0xBF));
        __m128i const isSecondOfMore = _mm_subs_epu8(back1, eachByte(0xDF));
        return zeroBytes(_mm_or_si128(isLead, isSecondOfMore));
    }

    __m128i bytes;
    __m128i back1;
    __m128i back2;
    __m128i back3;
};

/// Not 0 where a block's end cuts a character.
inline __m128i cutCharacters(__m128i block) {
    return _mm_subs_epu8(block,
                         _mm_setr_epi8(-1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, -1, static_cast<char>(0xEF),
                                       static_cast<char>(0xDF), static_cast<char>(0xBF)));
}

inline __m128i lowUnits(__m128i bytes) { return _mm_unpacklo_epi8(bytes, _mm_setzero_si128()); }
inline __m128i highUnits(__m128i bytes) { return _mm_unpackhi_epi8(bytes, _mm_setzero_si128()); }
inline __m128i lowTwice(__m128i bytes) { return _mm_unpacklo_epi8(bytes, bytes); }
inline __m128i highTwice(__m128i bytes) { return _mm_unpackhi_epi8(bytes, bytes); }

/// The units that end at the lower and at the upper eight bytes of a block.
struct UnitHalves {
    __m128i low;
    __m128i high;
};

/// \pre no character has four bytes
ZB_INLINE UnitHalves unitsOf(Utf8Block const& block) {
    __m128i const isContinuation = _mm_cmplt_epi8(block.bytes, _mm_setzero_si128());
    __m128i const lowest = _mm_and_si128(block.bytes, eachByte(0x7F));
    __m128i const middle = _mm_and_si128(_mm_and_si128(block.back1, isContinuation), eachByte(0x3F));
    __m128i const lead = _mm_subs_epu8(block.back2, eachByte(0xE0)); // 0 unless it leads three bytes or four
    __m128i const highest = _mm_and_si128(_mm_slli_epi16(lead, 4), eachByte(0xF0));
    return {_mm_or_si128(_mm_unpacklo_epi8(lowest, highest), _mm_slli_epi16(lowUnits(middle), 6)),
            _mm_or_si128(_mm_unpackhi_epi8(lowest, highest), _mm_slli_epi16(highUnits(middle), 6))};
}

/// Where the third and the fourth of four bytes are.
struct FourBytes {
    ZB_INLINE explicit FourBytes(Utf8Block const& block)
        : third(_mm_cmpeq_epi8(_mm_max_epu8(block.back2, eachByte(0xF0)), block.back2)),
          fourth(_mm_cmpeq_epi8(_mm_max_epu8(block.back3, eachByte(0xF0)), block.back3)) {}
    ZB_INLINE bool areAny() const { return bitsOf(_mm_or_si128(third, fourth)) != 0; }

    __m128i third;
    __m128i fourth;
};

/// The character's bits without the lowest six, to a high surrogate; its lowest twelve, to a low one.
ZB_INLINE __m128i withSurrogates(__m128i units, __m128i isHigh, __m128i isLow) {
    __m128i const high = _mm_add_epi16(_mm_srli_epi16(units, 4), _mm_set1_epi16(static_cast<short>(0xD7C0)));
    __m128i const low =
        _mm_or_si128(_mm_and_si128(units, _mm_set1_epi16(0x3FF)), _mm_set1_epi16(static_cast<short>(0xDC00)));
    __m128i const others = _mm_andnot_si128(_mm_or_si128(isHigh, isLow), units);
    return _mm_or_si128(others, _mm_or_si128(_mm_and_si128(isHigh, high), _mm_and_si128(isLow, low)));
}

/// Where the units come from that are kept of eight, and how many they are.
struct KeptUnits {
    std::array<std::array<std::uint8_t, BLOCK_BYTES>, 256> places;
    std::array<std::uint8_t, 256> counts;
};

inline constexpr KeptUnits KEPT_UNITS = [] {
    KeptUnits kept{};
    for (unsigned choice = 0; choice < 256; ++choice) {
        unsigned count = 0;
        for (unsigned unit = 0; unit < BLOCK_UNITS; ++unit) {
            if ((choice >> unit & 1) == 0) continue;
            kept.places[choice][2 * count] = static_cast<std::uint8_t>(2 * unit);
            kept.places[choice][2 * count + 1] = static_cast<std::uint8_t>(2 * unit + 1);
            ++count;
        }
        kept.counts[choice] = static_cast<std::uint8_t>(count);
    }
    return kept;
}();

ZB_SSSE3 inline std::uint64_t storeKept(__m128i units, unsigned choice, WChar* out) {
    store16(out, _mm_shuffle_epi8(units, load16(KEPT_UNITS.places[choice].data())));
    return KEPT_UNITS.counts[choice];
}

/// Stores the units of the places that are given. Touches up to 16.
/// \return how many
ZB_SSSE3 ZB_INLINE std::uint64_t storeUnits(Utf8Block const& block, unsigned places, WChar* out) {
    UnitHalves units = unitsOf(block);
    FourBytes const four(block);
    if (four.areAny()) {
        units.low = withSurrogates(units.low, lowTwice(four.third), lowTwice(four.fourth));
        units.high = withSurrogates(units.high, highTwice(four.third), highTwice(four.fourth));
    }
    std::uint64_t const count = storeKept(units.low, places & 0xFF, out);
    return count + storeKept(units.high, places >> BLOCK_UNITS, out + count);
}

// ---- a text in blocks -----------------------------------------------------------------------------------------------

/// What has been found of a text so far.
struct Utf8Check {
    __m128i before = _mm_setzero_si128(); ///< the last block
    __m128i wrong = _mm_setzero_si128();

    /// Notes that blocks of ASCII follow, which need no check of their own.
    ZB_INLINE void takeAscii() {
        wrong = _mm_or_si128(wrong, cutCharacters(before));
        before = _mm_setzero_si128();
    }
    /// \tparam checked  false for a text that is known to be valid
    template <bool checked = true>
    ZB_SSSE3 ZB_INLINE Utf8Block take(__m128i block) {
        Utf8Block const taken(before, block);
        if (checked) wrong = _mm_or_si128(wrong, taken.faults());
        before = block;
        return taken;
    }
    ZB_INLINE bool isValid() const { return bitsOf(zeroBytes(wrong)) == 0xFFFF; }
    ZB_INLINE bool isValidToTheEnd() {
        takeAscii();
        return isValid();
    }
};

/// The last `left` bytes of a text, fewer than a block, with zeros behind them.
ZB_SSSE3 inline __m128i lastUtf8Block(char const* text, char const* end, std::uint64_t left) {
    if (end - text >= static_cast<std::ptrdiff_t>(BLOCK_BYTES)) return movedToFront(load16(end - BLOCK_BYTES), left);
    char window[BLOCK_BYTES] = {};
    std::memcpy(window, end - left, left);
    return load16(window);
}

} // namespace ZOR_Basis::Utf

#endif

#endif
