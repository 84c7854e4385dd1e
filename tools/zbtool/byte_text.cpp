#include "tools/zbtool/byte_text.h"

#include "tools/zbtool/utf8.h"

namespace zbtool {
namespace {

constexpr std::string_view DIGITS = "0123456789abcdef";

/// -1 for what is no digit.
int digitOf(char c) {
    std::size_t const place = DIGITS.find(c >= 'A' && c <= 'F' ? static_cast<char>(c + ('a' - 'A')) : c);
    return place == std::string_view::npos ? -1 : static_cast<int>(place);
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
        bool const isControl = size == 1 && (static_cast<unsigned char>(bytes[0]) < 0x20 || bytes[0] == 0x7F);
        if (bytes[0] == '\\')
            text += "\\\\";
        else if (size == 0 || isControl)
            text += "\\x" + hexText(bytes.substr(0, 1));
        else
            text += bytes.substr(0, size);
        bytes.remove_prefix(size == 0 ? 1 : size);
    }
    return text;
}

} // namespace zbtool
