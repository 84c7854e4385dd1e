#include "basis/ground/processor.h"
#include "basis/text/utf.h"
#include "basis/text/utf8_block.h"
#include "basis/text/utf_characters.h"

#include <algorithm>

namespace ZOR_Basis::Utf {
namespace {

std::uint64_t lengthByCharacters(char const* text, std::uint64_t size) {
    auto const* const bytes = reinterpret_cast<Byte const*>(text);
    std::uint64_t units = 0;
    for (std::uint64_t done = 0; done < size;) {
        auto const [character, length] = decode(bytes + done, size - done);
        if (length == 0) return INVALID;
        units += utf16Units(character);
        done += length;
    }
    return units;
}

#if ZB_VECTORS

/// How many bytes at the front are ASCII, in whole blocks.
ZB_INLINE std::uint64_t asciiBlocks(char const* text, std::uint64_t size) {
    std::uint64_t done = 0;
    for (; done + 4 * BLOCK_BYTES <= size; done += 4 * BLOCK_BYTES) {
        __m128i const front = _mm_or_si128(load16(text + done), load16(text + done + BLOCK_BYTES));
        __m128i const back = _mm_or_si128(load16(text + done + 2 * BLOCK_BYTES), load16(text + done + 3 * BLOCK_BYTES));
        if (bitsOf(_mm_or_si128(front, back)) != 0) return done;
    }
    return done;
}

/// Checks a run of blocks, and adds up the bytes that give units.
class Counter {
public:
    ZB_SSSE3 ZB_INLINE void take(__m128i block) { units_ = _mm_sub_epi8(units_, check_.take(block).givesUnit()); }
    /// To be called before a byte of the sum can overflow.
    ZB_INLINE void addUp() {
        sum_ += sumOfBytes(units_);
        units_ = _mm_setzero_si128();
    }
    ZB_INLINE bool isValidToTheEnd() { return check_.isValidToTheEnd(); }
    std::uint64_t sum() const { return sum_; }

private:
    Utf8Check check_;
    __m128i units_ = _mm_setzero_si128();
    std::uint64_t sum_ = 0;
};

constexpr std::uint64_t BLOCKS_OF_A_ROUND = 255;

ZB_SSSE3 std::uint64_t lengthByBlocks(char const* text, std::uint64_t size) {
    std::uint64_t done = asciiBlocks(text, size);
    std::uint64_t const ascii = done;
    Counter counter;
    while (size - done >= BLOCK_BYTES) {
        for (std::uint64_t left = std::min((size - done) / BLOCK_BYTES, BLOCKS_OF_A_ROUND); left > 0; --left) {
            counter.take(load16(text + done));
            done += BLOCK_BYTES;
        }
        counter.addUp();
    }
    std::uint64_t behind = 0;
    if (done < size) {
        behind = BLOCK_BYTES - (size - done); // zeros, which count as characters
        counter.take(lastUtf8Block(text, text + size, size - done));
        counter.addUp();
    }
    return counter.isValidToTheEnd() ? ascii + counter.sum() - behind : INVALID;
}

#endif

} // namespace

std::uint64_t utf16Length(char const* text, std::uint64_t size) {
#if ZB_VECTORS
    if (detail::canUse(detail::Vectors::SSSE3)) return lengthByBlocks(text, size);
#endif
    return lengthByCharacters(text, size);
}

} // namespace ZOR_Basis::Utf
