#include "zor_basis/text/char_ops.h"

#include <cstring>
#include <limits>

namespace ZOR_Basis::detail {

std::uint64_t textLengthUpTo(char const* text, std::uint64_t limit) noexcept {
    if (limit == 0) return 0;
    auto const* end = static_cast<char const*>(std::memchr(text, '\0', limit));
    return end != nullptr ? static_cast<std::uint64_t>(end - text) : limit;
}

std::uint64_t textLengthUpTo(WChar const* text, std::uint64_t limit) noexcept {
    std::uint64_t length = 0;
    while (length < limit && text[length] != WChar()) ++length;
    return length;
}

char const* findText(char const* text, char const* wanted) noexcept {
    return text != nullptr && wanted != nullptr ? std::strstr(text, wanted) : nullptr;
}

WChar const* findText(WChar const* text, WChar const* wanted) noexcept {
    if (text == nullptr || wanted == nullptr) return nullptr;
    std::uint64_t const length = textLength(wanted);
    for (;; ++text) {
        if (compareTextsUpTo(text, wanted, length) == 0) return text;
        if (*text == WChar()) return nullptr;
    }
}

} // namespace ZOR_Basis::detail
