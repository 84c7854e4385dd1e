/// \file
/// UTF-8 and UTF-16 (RFC 3629, RFC 2781): both conversions, which check their sources, and the lengths of results.
///
/// Each function chooses by the processor: blocks of characters of any lengths, with SSSE3 or AVX2, or one character
/// after the other.

#ifndef BASIS_TEXT_UTF_H
#define BASIS_TEXT_UTF_H

#include "zor_basis/wide_char.h"

#include <cstdint>

namespace ZOR_Basis::Utf {

/// What is returned instead of a length: the text is not UTF-8, or its converted form exceeds the room.
inline constexpr std::uint64_t INVALID = ~std::uint64_t{0};
inline constexpr std::uint64_t NO_ROOM = INVALID - 1;

/// \return the code units of the UTF-16 form of `size` bytes of UTF-8; INVALID
std::uint64_t utf16Length(char const* text, std::uint64_t size);

/// Writes the UTF-16 form of `size` bytes of UTF-8. Overlong forms, surrogates, values above U+10FFFF, stray and
/// missing continuation bytes are invalid.
/// \param out  `room` units, none of which keeps its value; no terminator is written
/// \return the units of the whole text; INVALID or NO_ROOM. A text to which both apply gives either
std::uint64_t toUtf16(char const* text, std::uint64_t size, WChar* out, std::uint64_t room);

/// The same of a text that is valid, as `utf16Length` has found, into enough room.
/// \param room  the units of the whole text, at least
void validToUtf16(char const* text, std::uint64_t size, WChar* out, std::uint64_t room);

/// The bytes of the UTF-8 form of `size` units of UTF-16, an unpaired surrogate counting as U+FFFD.
std::uint64_t utf8Length(WChar const* text, std::uint64_t size);

/// What a conversion to UTF-8 has done.
struct Utf8Result {
    std::uint64_t units;       ///< of the text, converted: all, or as many as fit the room. No pair is ever split
    std::uint64_t bytes : 63;  ///< written
    std::uint64_t hasZero : 1; ///< whether zeros are among them
};

/// Writes the UTF-8 form of `size` units of UTF-16, U+FFFD for each unpaired surrogate. Without room for all it stops
/// less than eight units before the room ends.
/// \param out  `room` bytes, none of which keeps its value; no terminator is written
Utf8Result toUtf8(WChar const* text, std::uint64_t size, char* out, std::uint64_t room);

inline constexpr bool isSurrogate(std::uint32_t unit) { return (unit & 0xF800) == 0xD800; }
inline constexpr bool isHighSurrogate(std::uint32_t unit) { return (unit & 0xFC00) == 0xD800; }
inline constexpr bool isLowSurrogate(std::uint32_t unit) { return (unit & 0xFC00) == 0xDC00; }

} // namespace ZOR_Basis::Utf

#endif
