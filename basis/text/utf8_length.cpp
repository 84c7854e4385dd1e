#include "basis/text/utf.h"
#include "basis/text/utf16_block.h"
#include "basis/text/utf_characters.h"

#include <algorithm>

namespace ZOR_Basis::Utf {

#if ZB_VECTORS

namespace {

/// How many units at the front are ASCII, by four blocks.
std::uint64_t asciiFront(WChar const* text, std::uint64_t size) {
    constexpr std::uint64_t STEP = 4 * BLOCK_UNITS;
    std::uint64_t done = 0;
    for (; done + STEP <= size; done += STEP) {
        __m128i const front = _mm_or_si128(load16(text + done), load16(text + done + BLOCK_UNITS));
        __m128i const back = _mm_or_si128(load16(text + done + 2 * BLOCK_UNITS), load16(text + done + 3 * BLOCK_UNITS));
        if (!isAscii(_mm_or_si128(front, back))) break;
    }
    return done;
}

/// How far the bytes of eight units fall short of three each, negated. A pair's six count as four, where its high half
/// is.
/// \param next  the block that begins one unit later
__m128i savedIn(__m128i block, __m128i next) {
    __m128i const pair = _mm_and_si128(withUpper(block, 0xFC00, 0xD800), withUpper(next, 0xFC00, 0xDC00));
    return _mm_add_epi16(_mm_add_epi16(without(block, 0xFF80), without(block, 0xF800)), _mm_add_epi16(pair, pair));
}

/// The last `left` units of a text, one to eight, behind zeros.
/// \pre the text has eight
__m128i lastUnits(WChar const* end, std::uint64_t left) {
    static constexpr WChar MASK[2 * BLOCK_UNITS] = {0,      0,      0,      0,      0,      0,      0,      0,
                                                    0xFFFF, 0xFFFF, 0xFFFF, 0xFFFF, 0xFFFF, 0xFFFF, 0xFFFF, 0xFFFF};
    return _mm_and_si128(load16(end - BLOCK_UNITS), load16(MASK + left));
}

std::uint64_t lengthByBlocks(WChar const* text, std::uint64_t size) {
    constexpr std::uint64_t MOST_BLOCKS = 126; // at two a unit, more might overflow the byte that is summed
    std::uint64_t const ascii = asciiFront(text, size);
    std::uint64_t done = ascii;
    std::uint64_t saved = 0;
    __m128i sums = _mm_setzero_si128();
    while (size - done > BLOCK_UNITS) {
        saved += sumOfBytes(sums);
        sums = _mm_setzero_si128();
        for (std::uint64_t blocks = std::min((size - done - 1) / BLOCK_UNITS, MOST_BLOCKS); blocks > 0; --blocks) {
            sums = _mm_sub_epi16(sums, savedIn(load16(text + done), load16(text + done + 1)));
            done += BLOCK_UNITS;
        }
    }
    std::uint64_t const left = size - done;
    if (left > 0) {
        __m128i const last = lastUnits(text + size, left);
        sums = _mm_sub_epi16(sums, savedIn(last, _mm_srli_si128(last, sizeof(WChar))));
        saved -= 2 * (BLOCK_UNITS - left); // the zeros
    }
    return ascii + 3 * (size - ascii) - saved - sumOfBytes(sums);
}

} // namespace

#endif

std::uint64_t utf8Length(WChar const* text, std::uint64_t size) {
#if ZB_VECTORS
    if (size >= BLOCK_UNITS) return lengthByBlocks(text, size);
#endif
    std::uint64_t bytes = 0;
    for (std::uint64_t done = 0; done < size;) {
        auto const [character, units] = decode(text + done, size - done);
        bytes += utf8Bytes(character);
        done += units;
    }
    return bytes;
}

} // namespace ZOR_Basis::Utf
