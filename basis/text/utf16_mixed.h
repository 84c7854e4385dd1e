/// \file
/// Characters of one byte and of two, as in most texts of Europe: whole blocks, and the last units of a text.

#ifndef BASIS_TEXT_UTF16_MIXED_H
#define BASIS_TEXT_UTF16_MIXED_H

#include "basis/text/utf16_ascii.h"
#include "basis/text/utf16_shuffle.h"

#include <bit>
#include <cstring>

namespace ZOR_Basis::Utf {

/// Takes blocks until one begins with a character that has to be taken by itself, or the text or the room nears its
/// end.
template <class Shuffle>
ZB_INLINE void takeBlocks(Progress& progress) {
    while (progress.left() >= BLOCK_UNITS && progress.room() >= BLOCK_BYTES) {
        __m128i const block = load16(progress.text);
        progress.hasZero |= bitsOf(zeroUnits(block)) != 0;
        unsigned const ascii = bitsOf(without(block, 0xFF80));
        unsigned const bytes = ascii != 0xFFFF ? Shuffle::storeMixed(block, progress.out) : 0;
        if (bytes != 0) {
            progress.advance(BLOCK_UNITS, bytes);
            continue;
        }
        store8(progress.out, packed(block));
        unsigned const front = static_cast<unsigned>(std::countr_one(ascii)) / 2;
        if (front < BLOCK_UNITS) {
            progress.advance(front, front);
            return;
        }
        progress.advance(BLOCK_UNITS, BLOCK_UNITS);
        takeAsciiBlocks(progress);
    }
}

/// The last units, fewer than a block, with zeros behind them.
template <class Shuffle>
ZB_INLINE __m128i lastBlock(Progress const& progress) {
    std::uint64_t const left = progress.left();
    if (progress.done() + left >= BLOCK_UNITS) return Shuffle::lastOf(load16(progress.end - BLOCK_UNITS), left);
    WChar window[BLOCK_UNITS] = {};
    std::memcpy(window, progress.text, left * sizeof(WChar));
    return load16(window);
}

/// Takes the text's last units, if there are fewer than a block of them and none is above 0x7FF.
template <class Shuffle>
ZB_INLINE void takeEnd(Progress& progress) {
    std::uint64_t const left = progress.left();
    if (left >= BLOCK_UNITS || left == 0 || progress.room() < BLOCK_BYTES) return;
    __m128i const block = lastBlock<Shuffle>(progress);
    unsigned bytes = BLOCK_UNITS;
    if (isAscii(block)) {
        store8(progress.out, packed(block));
    } else {
        bytes = Shuffle::storeMixed(block, progress.out);
        if (bytes == 0) return;
    }
    std::uint64_t const behind = BLOCK_UNITS - left;
    progress.hasZero |= (bitsOf(zeroUnits(block)) << sizeof(WChar) * behind & 0xFFFF) != 0;
    progress.advance(left, bytes - behind);
}

} // namespace ZOR_Basis::Utf

#endif
