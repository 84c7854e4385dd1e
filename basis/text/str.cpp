#include "zor_basis/text/str.h"

#include <cctype>

namespace ZOR_Basis {

constinit char const* const Str::StrEmpty = "";

namespace {

unsigned hexDigitOr255(char c) noexcept {
    int const digit = Str::hexToDigit(c);
    return digit < 0 ? 255U : static_cast<unsigned>(digit);
}

} // namespace

void Str::ToLower(char* text, std::uint64_t n) noexcept {
    for (char* end = text + n; text != end; ++text) {
        *text = static_cast<char>(std::tolower(static_cast<unsigned char>(*text)));
    }
}

void Str::ToUpper(char* text, std::uint64_t n) noexcept {
    for (char* end = text + n; text != end; ++text) {
        *text = static_cast<char>(std::toupper(static_cast<unsigned char>(*text)));
    }
}

void Str::ch2hex(char c, char* digits) noexcept {
    static constexpr char const* HEX_DIGITS = "0123456789abcdef";
    auto const byte = static_cast<unsigned char>(c);
    digits[0] = HEX_DIGITS[byte >> 4];
    digits[1] = HEX_DIGITS[byte & 15];
}

char Str::decodeHexChar(char const* digits) noexcept {
    // kept text-03: stored names with stray characters decode to the same bytes everywhere
    return static_cast<char>(static_cast<unsigned char>(16 * hexDigitOr255(digits[0]) + hexDigitOr255(digits[1])));
}

} // namespace ZOR_Basis
