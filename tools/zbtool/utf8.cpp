#include "tools/zbtool/utf8.h"

#include <algorithm>
#include <iterator>

namespace zbtool {
namespace {

/// How many bytes follow a first byte, and what the first of them may be.
struct Lead {
    unsigned char first, last;
    std::size_t length;
    unsigned char lowest, highest;
};

// Overlong forms, surrogates and values above U+10FFFF differ from valid ones in the second byte.
constexpr Lead LEADS[] = {
    {0xC2, 0xDF, 2, 0x80, 0xBF}, {0xE0, 0xE0, 3, 0xA0, 0xBF}, {0xE1, 0xEC, 3, 0x80, 0xBF}, {0xED, 0xED, 3, 0x80, 0x9F},
    {0xEE, 0xEF, 3, 0x80, 0xBF}, {0xF0, 0xF0, 4, 0x90, 0xBF}, {0xF1, 0xF3, 4, 0x80, 0xBF}, {0xF4, 0xF4, 4, 0x80, 0x8F},
};

bool isBetween(char c, unsigned char lowest, unsigned char highest) {
    auto const byte = static_cast<unsigned char>(c);
    return byte >= lowest && byte <= highest;
}

} // namespace

std::size_t utf8Length(std::string_view text) {
    if (text.empty()) return 0;
    if (isBetween(text[0], 0, 0x7F)) return 1;
    for (Lead const& lead : LEADS) {
        if (!isBetween(text[0], lead.first, lead.last)) continue;
        if (text.size() < lead.length || !isBetween(text[1], lead.lowest, lead.highest)) return 0;
        for (std::size_t i = 2; i < lead.length; ++i) {
            if (!isBetween(text[i], 0x80, 0xBF)) return 0;
        }
        return lead.length;
    }
    return 0;
}

std::size_t unfinishedLength(std::string_view text) {
    for (std::size_t length = 1; length <= std::min<std::size_t>(text.size(), 3); ++length) {
        char const first = text[text.size() - length];
        if (isBetween(first, 0x80, 0xBF)) continue;
        auto const isLead = [&](Lead const& lead) {
            return lead.length > length && isBetween(first, lead.first, lead.last);
        };
        return std::any_of(std::begin(LEADS), std::end(LEADS), isLead) ? length : 0;
    }
    return 0;
}

bool isUtf8(std::string_view text) {
    while (!text.empty()) {
        std::size_t const size = utf8Length(text);
        if (size == 0) return false;
        text.remove_prefix(size);
    }
    return true;
}

void appendUtf8(std::string& text, std::uint32_t codePoint) {
    if (codePoint < 0x80) {
        text.push_back(static_cast<char>(codePoint));
        return;
    }
    int const following = codePoint < 0x800 ? 1 : codePoint < 0x10000 ? 2 : 3;
    constexpr unsigned MARKS[] = {0, 0xC0, 0xE0, 0xF0};
    text.push_back(static_cast<char>(MARKS[following] | codePoint >> (6 * following)));
    for (int i = following - 1; i >= 0; --i) text.push_back(static_cast<char>(0x80 | (codePoint >> (6 * i) & 0x3F)));
}

} // namespace zbtool
