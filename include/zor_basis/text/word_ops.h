/// \file
/// Copies and compares short narrow texts in words of 8 bytes, inline in the caller's code, for strings that own their
/// text. All bytes of an owned text may be read, including bytes behind a zero; longer texts are handled in the
/// library. Not meant for users.

#ifndef ZOR_BASIS_TEXT_WORD_OPS_H
#define ZOR_BASIS_TEXT_WORD_OPS_H

#include "zor_basis/export.h"
#include "zor_basis/ground/loads.h"
#include "zor_basis/text/char_ops.h"

#include <bit>
#include <cstdint>

namespace ZOR_Basis::detail {

/// `copyText`, `sameTexts` and the order of `compareTexts` for texts whose `length` bytes may all be read. For the
/// order, `length` is the size of the shorter text, whose terminator may be read too.
ZB_API_STRAIGHT void copyOwnedText(char* target, char const* source, std::uint64_t length) noexcept;
ZB_API_STRAIGHT bool sameOwnedTexts(char const* a, char const* b, std::uint64_t length) noexcept;
ZB_API_STRAIGHT int compareOwnedTexts(char const* a, char const* b, std::uint64_t length) noexcept;

/// Bytes in the opposite order, so that words compare as the texts in them. Compilers make one instruction of it.
inline std::uint64_t firstByteHighest(std::uint64_t word) noexcept {
    word = (word & 0x00FF00FF00FF00FFU) << 8 | (word >> 8 & 0x00FF00FF00FF00FFU);
    word = (word & 0x0000FFFF0000FFFFU) << 16 | (word >> 16 & 0x0000FFFF0000FFFFU);
    return word << 32 | word >> 32;
}

/// Two words side by side. The lowest bit of `decided` is in the first byte where they differ or end.
struct WordPair {
    WordPair(std::uint64_t a, std::uint64_t b) noexcept : word(a), different(a ^ b), decided(different | zerosIn(a)) {}

    /// Tells whether both texts end together, before any difference.
    /// \pre `decided` is not 0
    bool endTogether() const noexcept { return (decided & (0 - decided) & different) == 0; }
    /// Returns -1, 0 or 1.
    /// \pre `decided` is not 0
    int order() const noexcept {
        std::uint64_t const a = firstByteHighest(word);
        std::uint64_t const b = firstByteHighest(word ^ different);
        return endTogether() ? 0 : (a > b) - (a < b);
    }

    std::uint64_t word;
    std::uint64_t different;
    std::uint64_t decided;
};

/// Loads the first 4 and the last 4 of 4 to 8 bytes; the bytes keep their order, though some may occur twice.
inline std::uint64_t loadEnds(char const* text, std::uint64_t length) noexcept {
    return loadWord<std::uint32_t>(text) | std::uint64_t{loadWord<std::uint32_t>(text + length - 4)} << 32;
}

inline constexpr bool WORDS_BEGIN_LOW = std::endian::native == std::endian::little;

// Steps of a copy. Each reads everything before it writes anything, so that source and target may overlap. It is false,
// with nothing written, where a zero is among the bytes.

ZB_INLINE bool copy4To7(char* target, char const* source, std::uint64_t length) noexcept {
    auto const head = loadWord<std::uint32_t>(source);
    auto const tail = loadWord<std::uint32_t>(source + length - 4);
    if (hasZero(head | std::uint64_t{tail} << 32)) return false;
    storeWord(target, head);
    storeWord(target + length - 4, tail);
    return true;
}

#if ZB_VECTORS

ZB_INLINE bool copy8To16(char* target, char const* source, std::uint64_t length) noexcept {
    __m128i const both = _mm_unpacklo_epi64(load8(source), load8(source + length - 8));
    if (hasZero(both)) return false;
    store8(target, both);
    store8(target + length - 8, _mm_unpackhi_epi64(both, both));
    return true;
}

ZB_INLINE bool copy17To64(char* target, char const* source, std::uint64_t length) noexcept {
    __m128i const head = load16(source);
    __m128i const tail = load16(source + length - 16);
    if (length <= 32) {
        if (hasZero(_mm_min_epu8(head, tail))) return false;
    } else {
        __m128i const second = load16(source + 16);
        __m128i const third = load16(source + length - 32);
        if (hasZero(_mm_min_epu8(_mm_min_epu8(head, second), _mm_min_epu8(third, tail)))) return false;
        store16(target + 16, second);
        store16(target + length - 32, third);
    }
    store16(target, head);
    store16(target + length - 16, tail);
    return true;
}

#else

ZB_INLINE bool copy8To16(char* target, char const* source, std::uint64_t length) noexcept {
    auto const head = loadWord<std::uint64_t>(source);
    auto const tail = loadWord<std::uint64_t>(source + length - 8);
    if ((zerosIn(head) | zerosIn(tail)) != 0) return false;
    storeWord(target, head);
    storeWord(target + length - 8, tail);
    return true;
}

ZB_INLINE bool copy17To64(char*, char const*, std::uint64_t) noexcept { return false; }

#endif

/// Copies up to 64 bytes, all of which may be read; fewer than 4 by `copyUpTo3`.
/// \return false, with nothing written, for more bytes and if one of them is a zero
template <auto copyUpTo3>
ZB_INLINE bool copyInSteps(char* target, char const* source, std::uint64_t length) noexcept {
    if (length > 16) return length <= 64 && copy17To64(target, source, length);
    if (length >= 8) return copy8To16(target, source, length);
    return length >= 4 ? copy4To7(target, source, length) : copyUpTo3(target, source, length);
}

ZB_INLINE bool copyNothing(char*, char const*, std::uint64_t) noexcept { return false; }

/// The same in users' code, where the compiler decides what to inline, and fewer than 4 bytes are not worth it.
inline bool copyWords(char* target, char const* source, std::uint64_t length) noexcept {
    return copyInSteps<copyNothing>(target, source, length);
}

inline void copyOwned(char* target, char const* source, std::uint64_t length) noexcept {
    if (!copyWords(target, source, length)) copyOwnedText(target, source, length);
}

/// The same for a text that may end before its length, with nothing readable behind: what lies in the page of its first
/// byte can be read all the same, unless a sanitizer watches. The compiler must not know which text it is, as it would
/// take that for a mistake.
inline void copyGiven(char* target, char const* source, std::uint64_t length) noexcept {
#if ZB_CAN_HIDE && !ZB_ADDRESS_SANITIZER
    if (length <= 64 && (reinterpret_cast<std::uintptr_t>(source) & 4095U) <= 4096 - length) {
        char const* hidden = source;
        ZB_HIDE(hidden);
        if (copyWords(target, hidden, length)) return;
    }
#endif
    copyText(target, source, length);
}

/// Compares texts of strings with N inline bytes. If N is small, texts are usually short and compared here; other texts
/// go straight to the library.
template <std::uint64_t N>
inline bool sameOwned(char const* a, char const* b, std::uint64_t length) noexcept {
    if (N <= 16 && WORDS_BEGIN_LOW && length >= 4 && length <= 16) {
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

/// The same for the order: -1, 0 or 1. Both texts have a terminator at their size, so the terminator of the shorter one
/// decides at the latest.
template <std::uint64_t N>
inline int compareOwned(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept {
    std::uint64_t const length = aSize < bSize ? aSize : bSize;
    if (N <= 16 && WORDS_BEGIN_LOW && length >= 4 && length < 16) {
        if (length < 8) return WordPair(loadEnds(a, length + 1), loadEnds(b, length + 1)).order();
        WordPair const head(loadWord<std::uint64_t>(a), loadWord<std::uint64_t>(b));
        if (head.decided != 0) return head.order();
        return WordPair(loadWord<std::uint64_t>(a + length - 7), loadWord<std::uint64_t>(b + length - 7)).order();
    }
    int const order = compareOwnedTexts(a, b, length);
    return (order > 0) - (order < 0);
}

} // namespace ZOR_Basis::detail

#endif
