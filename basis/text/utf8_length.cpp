#include "basis/text/utf.h"
#include "basis/text/utf16_block.h"

#include <algorithm>

namespace ZOR_Basis::Utf {

namespace {

/// How far the bytes of the unit at `text[at]` fall short of three. A pair's six count as four.
unsigned savedAt(WChar const* text, std::uint64_t at, std::uint64_t size) {
    std::uint32_t const unit = text[at];
    if (unit < 0x80) return 2;
    if (unit < 0x800) return 1;
    return isHighSurrogate(unit) && at + 1 < size && isLowSurrogate(text[at + 1]) ? 2 : 0;
}

/// The same for eight units, negated. \pre a ninth unit
__m128i savedIn(WChar const* text) {
    __m128i const block = load16(text);
    __m128i const high = _mm_cmpeq_epi16(_mm_and_si128(block, units(0xFC00)), units(0xD800));
    __m128i const low = _mm_cmpeq_epi16(_mm_and_si128(load16(text + 1), units(0xFC00)), units(0xDC00));
    __m128i const pair = _mm_and_si128(high, low);
    return _mm_add_epi16(_mm_add_epi16(without(block, 0xFF80), without(block, 0xF800)), _mm_add_epi16(pair, pair));
}

} // namespace

std::uint64_t utf8Length(WChar const* text, std::uint64_t size) {
    constexpr std::uint64_t MOST_BLOCKS = 127; // at two a unit, more might overflow the byte that is summed
    std::uint64_t saved = 0;
    std::uint64_t done = 0;
    while (size - done > BLOCK_UNITS) {
        __m128i sums = _mm_setzero_si128();
        for (std::uint64_t blocks = std::min((size - done - 1) / BLOCK_UNITS, MOST_BLOCKS); blocks > 0; --blocks) {
            sums = _mm_sub_epi16(sums, savedIn(text + done));
            done += BLOCK_UNITS;
        }
        saved += sumOfBytes(sums);
    }
    for (; done < size; ++done) saved += savedAt(text, done, size);
    return 3 * size - saved;
}

} // namespace ZOR_Basis::Utf
