/// \file
/// A second, slow and plain decoder of UTF-8 and UTF-16, by tables of ranges (RFC 3629, section 4), with which the
/// conversions are compared.

#ifndef TESTS_TEXT_REFERENCE_UTF_H
#define TESTS_TEXT_REFERENCE_UTF_H

#include "zor_basis/wide_char.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace reference {

using WideText = std::basic_string<ZOR_Basis::WChar>;

struct Range {
    unsigned char low, high;
};

/// The byte ranges of each well-formed kind of character.
inline std::vector<std::vector<Range>> const& kinds() {
    static std::vector<std::vector<Range>> const table{
        {{0x00, 0x7F}},
        {{0xC2, 0xDF}, {0x80, 0xBF}},
        {{0xE0, 0xE0}, {0xA0, 0xBF}, {0x80, 0xBF}},
        {{0xE1, 0xEC}, {0x80, 0xBF}, {0x80, 0xBF}},
        {{0xED, 0xED}, {0x80, 0x9F}, {0x80, 0xBF}},
        {{0xEE, 0xEF}, {0x80, 0xBF}, {0x80, 0xBF}},
        {{0xF0, 0xF0}, {0x90, 0xBF}, {0x80, 0xBF}, {0x80, 0xBF}},
        {{0xF1, 0xF3}, {0x80, 0xBF}, {0x80, 0xBF}, {0x80, 0xBF}},
        {{0xF4, 0xF4}, {0x80, 0x8F}, {0x80, 0xBF}, {0x80, 0xBF}},
    };
    return table;
}

inline bool fits(std::string const& text, std::size_t at, std::vector<Range> const& kind) {
    if (text.size() - at < kind.size()) return false;
    for (std::size_t i = 0; i < kind.size(); ++i) {
        unsigned char const byte = static_cast<unsigned char>(text[at + i]);
        if (byte < kind[i].low || byte > kind[i].high) return false;
    }
    return true;
}

/// The characters of a UTF-8 text; no value if it is not well formed.
inline std::optional<std::vector<std::uint32_t>> characters(std::string const& text) {
    std::vector<std::uint32_t> found;
    for (std::size_t at = 0; at < text.size();) {
        std::size_t length = 0;
        for (auto const& kind : kinds()) {
            if (fits(text, at, kind)) length = kind.size();
        }
        if (length == 0) return std::nullopt;
        std::uint32_t value = static_cast<unsigned char>(text[at]);
        if (length > 1) value &= 0x7Fu >> length;
        for (std::size_t i = 1; i < length; ++i) value = value * 64 + (static_cast<unsigned char>(text[at + i]) % 64);
        found.push_back(value);
        at += length;
    }
    return found;
}

inline std::string utf8(std::vector<std::uint32_t> const& characters) {
    std::string text;
    auto put = [&text](std::uint32_t byte) { text.push_back(static_cast<char>(byte)); };
    for (std::uint32_t c : characters) {
        if (c <= 0x7F) {
            put(c);
        } else if (c <= 0x7FF) {
            put(192 + c / 64), put(128 + c % 64);
        } else if (c <= 0xFFFF) {
            put(224 + c / 4096), put(128 + c / 64 % 64), put(128 + c % 64);
        } else {
            put(240 + c / 262144), put(128 + c / 4096 % 64), put(128 + c / 64 % 64), put(128 + c % 64);
        }
    }
    return text;
}

inline WideText utf16(std::vector<std::uint32_t> const& characters) {
    WideText text;
    for (std::uint32_t c : characters) {
        if (c <= 0xFFFF) {
            text.push_back(static_cast<ZOR_Basis::WChar>(c));
        } else {
            text.push_back(static_cast<ZOR_Basis::WChar>(0xD800 + (c - 0x10000) / 0x400));
            text.push_back(static_cast<ZOR_Basis::WChar>(0xDC00 + (c - 0x10000) % 0x400));
        }
    }
    return text;
}

/// The characters of a UTF-16 text, U+FFFD for each unpaired surrogate.
inline std::vector<std::uint32_t> characters(WideText const& text) {
    std::vector<std::uint32_t> found;
    for (std::size_t at = 0; at < text.size(); ++at) {
        std::uint32_t const unit = text[at];
        bool const high = unit >= 0xD800 && unit <= 0xDBFF;
        bool const low = unit >= 0xDC00 && unit <= 0xDFFF;
        bool const lowFollows = at + 1 < text.size() && text[at + 1] >= 0xDC00 && text[at + 1] <= 0xDFFF;
        if (high && lowFollows) {
            found.push_back(0x10000 + (unit - 0xD800) * 0x400 + (text[++at] - 0xDC00u));
        } else {
            found.push_back(high || low ? 0xFFFD : unit);
        }
    }
    return found;
}

} // namespace reference

#endif
