/// \file
/// UTF-8 and UTF-16 (RFC 3629, RFC 2781), each checked and converted as it is read.

#ifndef BASIS_TEXT_UTF_H
#define BASIS_TEXT_UTF_H

#include "zor_basis/wide_char.h"

#include <cstdint>

namespace ZOR_Basis::Utf {

/// What a conversion gives instead of a length: the text is not UTF-8, or its converted form exceeds the room.
inline constexpr std::uint64_t INVALID = ~std::uint64_t{0};
inline constexpr std::uint64_t NO_ROOM = INVALID - 1;

/// The code units of the UTF-16 form of `size` bytes of valid UTF-8. Of other text: a number that `toUtf16` does not
/// exceed before it finds the fault.
std::uint64_t utf16Length(char const* text, std::uint64_t size);

/// Writes the UTF-16 form of `size` bytes of UTF-8. Overlong forms, surrogates, values above U+10FFFF, stray and
/// missing continuation bytes are invalid.
/// \param out  `room` units, none of which keeps its value; no terminator is written
/// \return the units of the whole text; INVALID or NO_ROOM, whichever is met first
std::uint64_t toUtf16(char const* text, std::uint64_t size, WChar* out, std::uint64_t room);

/// The same on processors without SSSE3.
std::uint64_t toUtf16WithoutShuffle(char const* text, std::uint64_t size, WChar* out, std::uint64_t room);

/// The bytes of the UTF-8 form of `size` units of UTF-16, an unpaired surrogate counting as U+FFFD.
std::uint64_t utf8Length(WChar const* text, std::uint64_t size);

/// What a conversion to UTF-8 has made.
struct Utf8Text {
    std::uint64_t size; ///< in bytes, or NO_ROOM
    bool hasZero;       ///< whether zeros are among them; means nothing where there was no room
};

/// Writes the UTF-8 form of `size` units of UTF-16, U+FFFD for each unpaired surrogate.
/// \param out  `room` bytes, none of which keeps its value; no terminator is written
Utf8Text toUtf8(WChar const* text, std::uint64_t size, char* out, std::uint64_t room);

/// The same on processors without SSSE3.
Utf8Text toUtf8WithoutShuffle(WChar const* text, std::uint64_t size, char* out, std::uint64_t room);

inline constexpr bool isSurrogate(std::uint32_t unit) { return (unit & 0xF800) == 0xD800; }
inline constexpr bool isHighSurrogate(std::uint32_t unit) { return (unit & 0xFC00) == 0xD800; }
inline constexpr bool isLowSurrogate(std::uint32_t unit) { return (unit & 0xFC00) == 0xDC00; }

} // namespace ZOR_Basis::Utf

#endif
