/// \file
/// Functions that narrow and wide text share, as templates over the character type. The text classes are built on them;
/// they are not meant for users.
///
/// There are two ways to copy. A text that has just been measured has no terminator inside and is moved as a whole
/// (`moveText`). A text whose length the caller gave is copied up to its terminator and padded with zeros (`copyText`);
/// nothing behind its terminator is read, because there may be nothing.

#ifndef ZOR_BASIS_TEXT_CHAR_OPS_H
#define ZOR_BASIS_TEXT_CHAR_OPS_H

#include "zor_basis/export.h"
#include "zor_basis/wide_char.h"

#include <concepts>
#include <cstdint>
#include <cstring>
#include <string>
#include <type_traits>

namespace ZOR_Basis::detail {

/// Every type that may be an index: all integers, and enumerations that convert to integers implicitly.
template <class T>
concept Index = std::integral<T> ||(std::is_enum_v<T>&& std::is_convertible_v<T, std::int64_t>);

/// An integer of at most 64 bits.
template <class T>
concept Number = Index<T> && sizeof(T) <= sizeof(std::int64_t);

/// Every other type that converts to `int` implicitly, although not every value survives the conversion.
template <class T>
concept LosesAsInt = !Number<T> && std::is_convertible_v<T, int> && !requires(T const& value) {
    int{value};
};

/// Units before the terminator.
template <class Char>
inline std::uint64_t textLength(Char const* text) noexcept {
    return std::char_traits<Char>::length(text);
}

/// Tells whether a text is null or empty.
template <class Char>
inline bool isNothing(Char const* text) noexcept {
    return text == nullptr || *text == Char();
}

/// The length of a (text, length) source: 0 for a null or empty text; otherwise a length of 0 means "measure it".
template <class Char>
inline std::uint64_t sourceLength(Char const* text, std::uint64_t length) noexcept {
    if (isNothing(text)) return 0;
    return length != 0 ? length : textLength(text);
}

/// Units before the terminator, at most `limit`. Reads nothing behind the terminator.
ZB_API std::uint64_t textLengthUpTo(char const* text, std::uint64_t limit) noexcept;
ZB_API std::uint64_t textLengthUpTo(WChar const* text, std::uint64_t limit) noexcept;

/// Less than 0, 0 or greater than 0, by unsigned units, up to the terminators. Null counts as the empty text.
ZB_API int compareTexts(char const* a, char const* b) noexcept;
ZB_API int compareTexts(WChar const* a, WChar const* b) noexcept;
/// The same; the sizes are only a hint how long the texts are.
ZB_API int compareTexts(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept;

/// The same over at most `limit` units.
ZB_API int compareTextsUpTo(char const* a, char const* b, std::uint64_t limit) noexcept;
ZB_API int compareTextsUpTo(WChar const* a, WChar const* b, std::uint64_t limit) noexcept;

/// Tells whether the texts are equal over so many units, or up to a common terminator before that.
ZB_API bool sameTexts(char const* a, char const* b, std::uint64_t length) noexcept;
ZB_API bool sameTexts(WChar const* a, WChar const* b, std::uint64_t length) noexcept;

/// The first occurrence of `wanted` in `text`, or null; a null text or a null `wanted` has none.
ZB_API char const* findText(char const* text, char const* wanted) noexcept;
ZB_API WChar const* findText(WChar const* text, WChar const* wanted) noexcept;

/// Copies the text before the terminator, at most `length` units, and pads with zeros to `length` units. Writes no
/// terminator behind them. The source may overlap the target.
ZB_API_STRAIGHT void copyText(char* target, char const* source, std::uint64_t length) noexcept;
ZB_API void copyText(WChar* target, WChar const* source, std::uint64_t length) noexcept;

// The compiler cannot see that short texts never reach the wide moves.
#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Warray-bounds"
#pragma GCC diagnostic ignored "-Wstringop-overflow"
#pragma GCC diagnostic ignored "-Wstringop-overread"
#endif

/// Moves `Block`-sized ends, which together cover `bytes` bytes. Both ends are read before anything is written.
template <class Block>
inline void moveEnds(void* target, void const* source, std::uint64_t bytes) noexcept {
    std::uint64_t const last = bytes - sizeof(Block);
    Block head;
    Block tail;
    std::memcpy(&head, source, sizeof(Block));
    std::memcpy(&tail, static_cast<char const*>(source) + last, sizeof(Block));
    std::memcpy(target, &head, sizeof(Block));
    std::memcpy(static_cast<char*>(target) + last, &tail, sizeof(Block));
}

/// Moves bytes between ranges that may overlap; short texts without a call.
inline void moveBytes(void* target, void const* source, std::uint64_t bytes) noexcept {
    struct Sixteen {
        std::uint64_t half[2];
    };
    if (bytes > 2 * sizeof(Sixteen)) {
        std::memmove(target, source, bytes);
    } else if (bytes >= sizeof(Sixteen)) {
        moveEnds<Sixteen>(target, source, bytes);
    } else if (bytes >= sizeof(std::uint64_t)) {
        moveEnds<std::uint64_t>(target, source, bytes);
    } else if (bytes >= sizeof(std::uint32_t)) {
        moveEnds<std::uint32_t>(target, source, bytes);
    } else if (bytes >= sizeof(std::uint16_t)) {
        moveEnds<std::uint16_t>(target, source, bytes);
    } else if (bytes == 1) {
        std::memcpy(target, source, 1);
    }
}

#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic pop
#endif

/// Moves `length` units, all of which may be read. The source may overlap the target.
template <class Char>
inline void moveText(Char* target, Char const* source, std::uint64_t length) noexcept {
    moveBytes(target, source, length * sizeof(Char));
}

} // namespace ZOR_Basis::detail

#endif
