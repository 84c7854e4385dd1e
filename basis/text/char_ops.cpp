#include "zor_basis/text/char_ops.h"

#include <cstring>
#include <limits>

namespace ZOR_Basis::detail {

namespace {

template <class Char>
Char const* textOrEmpty(Char const* text) noexcept {
    static constexpr Char Empty[1] = {};
    return text != nullptr ? text : Empty;
}

template <class Char>
void copyUpToTerminator(Char* target, Char const* source, std::uint64_t length) noexcept {
    if (length == 0) return;
    std::uint64_t const copied = textLengthUpTo(source, length);
    std::memmove(target, source, copied * sizeof(Char));
    std::memset(target + copied, 0, (length - copied) * sizeof(Char));
}

} // namespace

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

int compareTexts(char const* a, char const* b) noexcept { return std::strcmp(textOrEmpty(a), textOrEmpty(b)); }

int compareTexts(WChar const* a, WChar const* b) noexcept {
    return compareTextsUpTo(a, b, std::numeric_limits<std::uint64_t>::max());
}

int compareTextsUpTo(char const* a, char const* b, std::uint64_t limit) noexcept {
    return std::strncmp(textOrEmpty(a), textOrEmpty(b), limit);
}

int compareTextsUpTo(WChar const* a, WChar const* b, std::uint64_t limit) noexcept {
    a = textOrEmpty(a);
    b = textOrEmpty(b);
    for (; limit > 0; ++a, ++b, --limit) {
        if (*a != *b) return static_cast<int>(*a) - static_cast<int>(*b);
        if (*a == WChar()) return 0;
    }
    return 0;
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

// kept text-06: the size is what the caller said, so the units behind the terminator have to be defined
void copyText(char* target, char const* source, std::uint64_t length) noexcept {
    copyUpToTerminator(target, source, length);
}

void copyText(WChar* target, WChar const* source, std::uint64_t length) noexcept {
    copyUpToTerminator(target, source, length);
}

} // namespace ZOR_Basis::detail
