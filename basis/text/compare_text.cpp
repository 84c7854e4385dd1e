#include "zor_basis/text/word_ops.h"

#include "basis/ground/processor.h"
#include "basis/text/text_pair.h"
#include "basis/text/wide_text_pair.h"

#include <algorithm>
#include <cstring>
#include <limits>

namespace ZOR_Basis::detail {

int compareTexts(char const* a, char const* b) noexcept { return std::strcmp(textOrEmpty(a), textOrEmpty(b)); }

int compareTexts(WChar const* a, WChar const* b) noexcept {
    return compareTextsUpTo(a, b, std::numeric_limits<std::uint64_t>::max());
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

bool sameTexts(WChar const* a, WChar const* b, std::uint64_t length) noexcept {
    return compareTextsUpTo(a, b, length) == 0;
}

int compareTextsUpTo(char const* a, char const* b, std::uint64_t limit) noexcept {
    return std::strncmp(textOrEmpty(a), textOrEmpty(b), limit);
}

#if ZB_VECTOR_TEXT

namespace {

ZB_INLINE bool sameLongTexts(char const* a, char const* b, std::uint64_t length) noexcept {
#if ZB_WIDE_VECTOR_TEXT
    if (canUse(Vectors::AVX2)) [[likely]]
        return sameLongByWide(a, b, length);
#endif
    return sameLongByNarrow(a, b, length);
}

ZB_INLINE int orderOfLongTexts(char const* a, char const* b, std::uint64_t length) noexcept {
#if ZB_WIDE_VECTOR_TEXT
    if (canUse(Vectors::AVX2)) [[likely]]
        return orderOfLongByWide(a, b, length);
#endif
    return orderOfLongByNarrow(a, b, length);
}

template <class Text>
ZB_INLINE bool same(char const* a, char const* b, std::uint64_t length) noexcept {
    if (!Text::readable(a, b, length)) [[unlikely]]
        return sameByRuntime(a, b, length);
    if (length > 64) [[unlikely]]
        return sameLongTexts(a, b, length);
    if (length > 16) [[likely]]
        return sameMediumTexts(a, b, length);
    return length == 0 || sameShortTexts(a, b, length);
}

/// The order of texts of which one is likely to end at the length.
template <class Text>
ZB_INLINE int order(char const* a, char const* b, std::uint64_t length) noexcept {
    if (length < 4 || !Text::readable(a, b, length)) [[unlikely]]
        return orderByRuntime(a, b);
    if (length > 64) [[unlikely]]
        return orderOfLongTexts(a, b, length);
    if (length <= 16) [[unlikely]]
        return orderOfShortTexts(a, b, length);
    return orderOfMediumTexts(a, b, length);
}

} // namespace

bool sameTexts(char const* a, char const* b, std::uint64_t length) noexcept { return same<GivenPair>(a, b, length); }

bool sameOwnedTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    return same<OwnedPair>(a, b, length);
}

int compareTexts(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept {
    return order<GivenPair>(a, b, std::min(aSize, bSize));
}

int compareOwnedTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    return order<OwnedPair>(a, b, length);
}

#else

bool sameTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    return compareTextsUpTo(a, b, length) == 0;
}

bool sameOwnedTexts(char const* a, char const* b, std::uint64_t length) noexcept { return sameTexts(a, b, length); }

int compareTexts(char const* a, std::uint64_t, char const* b, std::uint64_t) noexcept { return compareTexts(a, b); }

int compareOwnedTexts(char const* a, char const* b, std::uint64_t) noexcept { return compareTexts(a, b); }

#endif

} // namespace ZOR_Basis::detail
