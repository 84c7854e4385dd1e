/// \file
/// Short narrow texts by words of 8 bytes, in the caller's code: copying and comparing strings that own their text. All
/// bytes of an owned text may be read, whatever lies among them; what is longer goes into the library. Users have no need
/// of it.

#ifndef ZOR_BASIS_TEXT_WORD_OPS_H
#define ZOR_BASIS_TEXT_WORD_OPS_H

#include "zor_basis/export.h"
#include "zor_basis/text/char_ops.h"

#include <bit>
#include <cstdint>
#include <cstring>

namespace ZOR_Basis::detail {

/// `copyText`, `sameTexts` and the order of `compareTexts` for texts whose `length` bytes may all be read; for the order
/// the terminator behind them too.
ZB_API void copyOwnedText(char* target, char const* source, std::uint64_t length) noexcept;
ZB_API bool sameOwnedTexts(char const* a, char const* b, std::uint64_t length) noexcept;
ZB_API int compareOwnedTexts(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept;

template <class Word>
inline Word loadWord(char const* text) noexcept {
    Word word;
    std::memcpy(&word, text, sizeof word);
    return word;
}

/// The highest bit of the first zero byte and of some behind it; 0 where there is none.
inline std::uint64_t zerosIn(std::uint64_t word) noexcept {
    return (word - 0x0101010101010101U) & ~word & 0x8080808080808080U;
}

/// Bytes in the opposite order, so that words compare as the texts in them. Compilers make one instruction of it.
inline std::uint64_t firstByteHighest(std::uint64_t word) noexcept {
    word = (word & 0x00FF00FF00FF00FFU) << 8 | (word >> 8 & 0x00FF00FF00FF00FFU);
    word = (word & 0x0000FFFF0000FFFFU) << 16 | (word >> 16 & 0x0000FFFF0000FFFFU);
    return word << 32 | word >> 32;
}

/// Two words side by side. The lowest bit of `decided` is in the first byte where they differ or end.
struct WordPair {
    WordPair(std::uint64_t a, std::uint64_t b) noexcept : word(a), different(a ^ b), decided(different | zerosIn(a)) {}

    /// Whether they end together, before any difference; where they are decided.
    bool endTogether() const noexcept { return (decided & (0 - decided) & different) == 0; }
    /// -1, 0 or 1; where they are decided.
    int order() const noexcept {
        std::uint64_t const a = firstByteHighest(word);
        std::uint64_t const b = firstByteHighest(word ^ different);
        return endTogether() ? 0 : (a > b) - (a < b);
    }

    std::uint64_t word;
    std::uint64_t different;
    std::uint64_t decided;
};

/// The first 4 and the last 4 of 4 to 8 bytes; bytes keep their order, though some may be there twice.
inline std::uint64_t loadEnds(char const* text, std::uint64_t length) noexcept {
    return loadWord<std::uint32_t>(text) | std::uint64_t{loadWord<std::uint32_t>(text + length - 4)} << 32;
}

inline constexpr bool WordsBeginLow = std::endian::native == std::endian::little;

inline void copyOwned(char* target, char const* source, std::uint64_t length) noexcept {
    if (length > 16) return copyOwnedText(target, source, length);
    if (length >= 8) {
        auto const head = loadWord<std::uint64_t>(source);
        auto const tail = loadWord<std::uint64_t>(source + length - 8);
        if ((zerosIn(head) | zerosIn(tail)) == 0) {
            std::memcpy(target, &head, sizeof head);
            std::memcpy(target + length - 8, &tail, sizeof tail);
            return;
        }
    } else if (length >= 4) {
        auto const head = loadWord<std::uint32_t>(source);
        auto const tail = loadWord<std::uint32_t>(source + length - 4);
        if (zerosIn(head | std::uint64_t{tail} << 32) == 0) {
            std::memcpy(target, &head, sizeof head);
            std::memcpy(target + length - 4, &tail, sizeof tail);
            return;
        }
    }
    copyOwnedText(target, source, length);
}

inline bool sameOwned(char const* a, char const* b, std::uint64_t length) noexcept {
    if (WordsBeginLow && length >= 4 && length <= 16) {
        if (length < 8) {
            WordPair const both(loadEnds(a, length), loadEnds(b, length));
            return both.different == 0 || both.endTogether();
        }
        WordPair const head(loadWord<std::uint64_t>(a), loadWord<std::uint64_t>(b));
        if (head.decided != 0) return head.endTogether();
        WordPair const tail(loadWord<std::uint64_t>(a + length - 8), loadWord<std::uint64_t>(b + length - 8));
        return tail.different == 0 || tail.endTogether();
    }
    return sameOwnedTexts(a, b, length);
}

/// -1, 0 or 1; both texts have a terminator at their size.
inline int compareOwned(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept {
    std::uint64_t const length = (aSize < bSize ? aSize : bSize) + 1;
    if (WordsBeginLow && length >= 4 && length <= 16) {
        if (length < 8) {
            WordPair const both(loadEnds(a, length), loadEnds(b, length));
            if (both.decided != 0) return both.order();
        } else {
            WordPair const head(loadWord<std::uint64_t>(a), loadWord<std::uint64_t>(b));
            if (head.decided != 0) return head.order();
            WordPair const tail(loadWord<std::uint64_t>(a + length - 8), loadWord<std::uint64_t>(b + length - 8));
            if (tail.decided != 0) return tail.order();
        }
    }
    int const order = compareOwnedTexts(a, aSize, b, bSize);
    return (order > 0) - (order < 0);
}

} // namespace ZOR_Basis::detail

#endif
