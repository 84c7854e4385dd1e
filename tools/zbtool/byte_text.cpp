#include "tools/zbtool/byte_text.h"

#include "tools/zbtool/utf8.h"

#include <algorithm>

namespace zbtool {
namespace {

constexpr std::string_view DIGITS = "0123456789abcdef";

/// -1 for what is no digit.
int digitOf(char c) {
    std::size_t const place = DIGITS.find(c >= 'A' && c <= 'F' ? static_cast<char>(c + ('a' - 'A')) : c);
    return place == std::string_view::npos ? -1 : static_cast<int>(place);
}

bool isBelow(char c, unsigned char end) { return static_cast<unsigned char>(c) < end; }

/// Whether a character, or a byte that belongs to none, is a control character: U+0000 to U+001F, U+007F to U+009F.
bool isControl(std::string_view character) {
    if (character.size() == 1)
        return isBelow(character[0], 0x20) || (!isBelow(character[0], 0x7F) && isBelow(character[0], 0xA0));
    return character.size() == 2 && character[0] == '\xC2' && isBelow(character[1], 0xA0);
}

/// Whether a text begins with the end of a line or with a tab. A lone return would overwrite the line.
bool beginsLayout(std::string_view text) { return text[0] == '\n' || text[0] == '\t' || text.starts_with("\r\n"); }

std::string harmless(std::string_view bytes, bool keepsLayout) {
    std::string text;
    while (!bytes.empty()) {
        std::size_t const size = std::max<std::size_t>(utf8Length(bytes), 1);
        bool const isKept = !isControl(bytes.substr(0, size)) || (keepsLayout && beginsLayout(bytes));
        for (char c : bytes.substr(0, size)) text += isKept ? std::string(1, c) : "\\x" + hexText({&c, 1});
        bytes.remove_prefix(size);
    }
    return text;
}

} // namespace

std::string hexText(std::string_view bytes) {
    std::string text;
    for (char c : bytes) {
        auto const byte = static_cast<unsigned char>(c);
        text.push_back(DIGITS[byte >> 4]);
        text.push_back(DIGITS[byte & 15]);
    }
    return text;
}

bool readHex(std::string_view text, std::string& bytes) {
    if (text.size() % 2 != 0) return false;
    bytes.clear();
    for (std::size_t i = 0; i < text.size(); i += 2) {
        int const high = digitOf(text[i]);
        int const low = digitOf(text[i + 1]);
        if (high < 0 || low < 0) return false;
        bytes.push_back(static_cast<char>(high * 16 + low));
    }
    return true;
}

std::string visibleText(std::string_view bytes) {
    std::string text;
    while (!bytes.empty()) {
        std::size_t const size = utf8Length(bytes);
        if (bytes[0] == '\\')
            text += "\\\\";
        else if (size == 0 || (size == 1 && isControl(bytes.substr(0, 1))))
            text += "\\x" + hexText(bytes.substr(0, 1));
        else
            text += bytes.substr(0, size);
        bytes.remove_prefix(size == 0 ? 1 : size);
    }
    return text;
}

std::string harmlessText(std::string_view bytes) { return harmless(bytes, false); }
std::string harmlessLines(std::string_view bytes) { return harmless(bytes, true); }

} // namespace zbtool
