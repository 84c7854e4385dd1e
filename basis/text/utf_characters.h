/// \file
/// One character at a time: checked, decoded and encoded.

#ifndef BASIS_TEXT_UTF_CHARACTERS_H
#define BASIS_TEXT_UTF_CHARACTERS_H

#include "basis/text/utf.h"

#include <cstdint>

namespace ZOR_Basis::Utf {

using Byte = unsigned char;

inline constexpr std::uint32_t REPLACEMENT = 0xFFFD;
inline constexpr std::uint64_t LONGEST_CHARACTER = 4;

struct Decoded {
    std::uint32_t character;
    unsigned length; ///< in what was decoded; 0: invalid or cut off
};

inline constexpr bool isContinuation(Byte byte) { return (byte & 0xC0) == 0x80; }

/// The character at the front of `size` bytes, at least 1.
inline Decoded decode(Byte const* text, std::uint64_t size) {
    std::uint32_t const lead = text[0];
    auto const rest = [text](unsigned i) { return static_cast<std::uint32_t>(text[i] & 0x3F); };
    if (lead < 0x80) return {lead, 1};
    if (lead < 0xE0) {
        if (lead < 0xC2 || size < 2 || !isContinuation(text[1])) return {};
        return {(lead & 0x1F) << 6 | rest(1), 2};
    }
    if (size < 3 || !isContinuation(text[1]) || !isContinuation(text[2])) return {};
    if (lead < 0xF0) {
        std::uint32_t const character = (lead & 0x0F) << 12 | rest(1) << 6 | rest(2);
        return character >= 0x800 && !isSurrogate(character) ? Decoded{character, 3} : Decoded{};
    }
    if (lead > 0xF4 || size < 4 || !isContinuation(text[3])) return {};
    std::uint32_t const character = (lead & 0x07) << 18 | rest(1) << 12 | rest(2) << 6 | rest(3);
    return character - 0x10000 <= 0xFFFFF ? Decoded{character, 4} : Decoded{};
}

/// The character at the front of `size` units, at least 1; U+FFFD for an unpaired surrogate.
inline Decoded decode(WChar const* text, std::uint64_t size) {
    std::uint32_t const unit = text[0];
    if (!isSurrogate(unit)) return {unit, 1};
    bool const isPair = isHighSurrogate(unit) && size > 1 && isLowSurrogate(text[1]);
    if (!isPair) return {REPLACEMENT, 1};
    return {0x10000 + ((unit & 0x3FF) << 10 | (text[1] & 0x3FFu)), 2};
}

inline unsigned utf16Units(std::uint32_t character) { return character < 0x10000 ? 1 : 2; }

inline unsigned utf8Bytes(std::uint32_t character) {
    if (character < 0x800) return character < 0x80 ? 1 : 2;
    return character < 0x10000 ? 3 : 4;
}

inline void encode(std::uint32_t character, WChar* out) {
    if (character < 0x10000) {
        out[0] = static_cast<WChar>(character);
    } else {
        out[0] = static_cast<WChar>(0xD7C0 + (character >> 10));
        out[1] = static_cast<WChar>(0xDC00 + (character & 0x3FF));
    }
}

/// \param bytes  those of the character
inline void encode(std::uint32_t character, unsigned bytes, char* out) {
    static constexpr std::uint32_t MARK[] = {0, 0, 0xC0, 0xE0, 0xF0};
    for (unsigned i = bytes - 1; i > 0; --i, character >>= 6) out[i] = static_cast<char>(0x80 | (character & 0x3F));
    out[0] = static_cast<char>(MARK[bytes] | character);
}

} // namespace ZOR_Basis::Utf

#endif
