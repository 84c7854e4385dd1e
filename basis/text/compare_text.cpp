#include "zor_basis/text/word_ops.h"

#include "basis/text/vector_text.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <limits>

namespace ZOR_Basis::detail {

namespace {

template <class Char>
Char const* textOrEmpty(Char const* text) noexcept {
    static constexpr Char Empty[1] = {};
    return text != nullptr ? text : Empty;
}

#if ZB_VECTOR_TEXT

/// Two texts side by side, a bit for each place: where they differ, and where they differ or end. The first bit of
/// `decided` decides; places keep their order, though some may be there twice.
template <class Bits>
struct Places {
    Bits different;
    Bits decided;

    bool same() const noexcept { return (decided & (0 - decided) & different) == 0; }
    std::uint64_t first() const noexcept { return static_cast<std::uint64_t>(std::countr_zero(decided)); }
};

inline Places<std::uint32_t> placesOf(__m128i a, __m128i b) noexcept {
    __m128i const equal = _mm_cmpeq_epi8(a, b);
    return {static_cast<std::uint32_t>(_mm_movemask_epi8(equal)) ^ 0xFFFFU, zerosOf(_mm_min_epu8(equal, a))};
}

/// How much of two texts may be read before anything is known about their bytes.
struct Given {
    static bool readable(char const* a, char const* b, std::uint64_t length) noexcept {
        return inOnePage(a, length) && inOnePage(b, length);
    }
};
struct Owned {
    static bool readable(char const*, char const*, std::uint64_t) noexcept { return true; }
};

// Both ends of a text in one vector. Where they do not fill it, the texts look as if they ended together.
inline __m128i ends1To3(char const* text, std::uint64_t length) noexcept {
    auto const byte = [text](std::uint64_t i) { return static_cast<int>(static_cast<unsigned char>(text[i])); };
    return _mm_cvtsi32_si128(byte(0) | byte(length / 2) << 8 | byte(length - 1) << 16);
}
inline __m128i ends4To7(char const* text, std::uint64_t length) noexcept {
    return _mm_unpacklo_epi32(_mm_cvtsi32_si128(static_cast<int>(load4(text))),
                              _mm_cvtsi32_si128(static_cast<int>(load4(text + length - 4))));
}
inline __m128i ends8To16(char const* text, std::uint64_t length) noexcept {
    return _mm_unpacklo_epi64(load8(text), load8(text + length - 8));
}

/// 17 to 32 bytes.
inline Places<std::uint32_t> placesOfTwo(char const* a, char const* b, std::uint64_t length) noexcept {
    auto const head = placesOf(load16(a), load16(b));
    auto const tail = placesOf(load16(a + length - 16), load16(b + length - 16));
    return {head.different | tail.different << 16, head.decided | tail.decided << 16};
}

int orderAt(char const* a, char const* b, std::uint64_t place) noexcept {
    return static_cast<int>(static_cast<unsigned char>(a[place])) -
           static_cast<int>(static_cast<unsigned char>(b[place]));
}

ZB_COLD bool sameByRuntime(char const* a, char const* b, std::uint64_t length) noexcept {
    return std::strncmp(textOrEmpty(a), textOrEmpty(b), length) == 0;
}

ZB_COLD int orderByRuntime(char const* a, char const* b) noexcept {
    return std::strcmp(textOrEmpty(a), textOrEmpty(b));
}

/// Of texts that are equal so far and have not ended.
inline int orderAtTheEnd(char const* a, char const* b) noexcept {
    if (*a == *b && *a != '\0') [[unlikely]]
        return orderByRuntime(a, b);
    return orderAt(a, b, 0);
}

#if ZB_WIDE_VECTOR_TEXT

constexpr std::uint64_t Undecided = std::numeric_limits<std::uint64_t>::max();

ZB_AVX2 ZB_INLINE unsigned zerosOf(__m256i bytes) noexcept {
    return static_cast<unsigned>(_mm256_movemask_epi8(_mm256_cmpeq_epi8(bytes, _mm256_setzero_si256())));
}

/// Where the texts are decided in two vectors of 32 bytes, the second of which may overlap the first.
ZB_AVX2 ZB_INLINE std::uint64_t decisionIn(char const* a, char const* b, std::uint64_t second) noexcept {
    __m256i const head = load32(a);
    __m256i const tail = load32(a + second);
    __m256i const undecidedHead = _mm256_min_epu8(_mm256_cmpeq_epi8(head, load32(b)), head);
    __m256i const undecidedTail = _mm256_min_epu8(_mm256_cmpeq_epi8(tail, load32(b + second)), tail);
    if (zerosOf(_mm256_min_epu8(undecidedHead, undecidedTail)) == 0) return Undecided;
    unsigned const headPlaces = zerosOf(undecidedHead);
    if (headPlaces != 0) return static_cast<std::uint64_t>(std::countr_zero(headPlaces));
    return second + static_cast<std::uint64_t>(std::countr_zero(zerosOf(undecidedTail)));
}

/// More than 32 bytes, in runs of 64. The last run of a longer text begins in the one before.
template <class Text>
ZB_AVX2 ZB_COLD bool sameLongTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    for (; length > 64; a += 64, b += 64, length -= 64) {
        if (!Text::readable(a, b, 64)) return sameByRuntime(a, b, length);
        std::uint64_t const place = decisionIn(a, b, 32);
        if (place != Undecided) return a[place] == b[place];
    }
    if (!Text::readable(a, b, length)) return sameByRuntime(a, b, length);
    std::uint64_t const back = length < 32 ? 32 - length : 0;
    a -= back;
    b -= back;
    std::uint64_t const place = decisionIn(a, b, length + back - 32);
    return place == Undecided || a[place] == b[place];
}

/// The same, and how texts compare that are likely to end there.
template <class Text>
ZB_AVX2 ZB_COLD int orderOfLongTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    for (; length > 64; a += 64, b += 64, length -= 64) {
        if (!Text::readable(a, b, 64)) return orderByRuntime(a, b);
        std::uint64_t const place = decisionIn(a, b, 32);
        if (place != Undecided) return orderAt(a, b, place);
    }
    if (!Text::readable(a, b, length)) return orderByRuntime(a, b);
    std::uint64_t const back = length < 32 ? 32 - length : 0;
    a -= back;
    b -= back;
    std::uint64_t const second = length + back - 32;
    std::uint64_t const place = decisionIn(a, b, second);
    return place != Undecided ? orderAt(a, b, place) : orderAtTheEnd(a + second + 32, b + second + 32);
}

#endif

template <class Text>
bool same(char const* a, char const* b, std::uint64_t length) noexcept {
#if ZB_WIDE_VECTOR_TEXT
    if (length > 32 && __builtin_cpu_supports("avx2")) return sameLongTexts<Text>(a, b, length);
#endif
    if (length > 32 || !Text::readable(a, b, length)) [[unlikely]]
        return sameByRuntime(a, b, length);
    if (length > 16) return placesOfTwo(a, b, length).same();
    if (length >= 8) [[likely]]
        return placesOf(ends8To16(a, length), ends8To16(b, length)).same();
    if (length >= 4) return placesOf(ends4To7(a, length), ends4To7(b, length)).same();
    return length == 0 || placesOf(ends1To3(a, length), ends1To3(b, length)).same();
}

template <class Text>
int order(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept {
    std::uint64_t const length = std::min(aSize, bSize); // where the shorter one is likely to end
#if ZB_WIDE_VECTOR_TEXT
    if (length > 32 && __builtin_cpu_supports("avx2")) return orderOfLongTexts<Text>(a, b, length);
#endif
    if (length > 32 || length < 4 || !Text::readable(a, b, length)) return orderByRuntime(a, b);
    Places<std::uint32_t> places;
    std::uint64_t front; // places from the first end of the texts
    if (length > 16) {
        places = placesOfTwo(a, b, length);
        front = 16;
    } else if (length >= 8) [[likely]] {
        places = placesOf(ends8To16(a, length), ends8To16(b, length));
        front = 8;
    } else {
        places = placesOf(ends4To7(a, length), ends4To7(b, length));
        places.decided &= 0xFFU;
        front = 4;
    }
    if (places.decided == 0) return orderAtTheEnd(a + length, b + length);
    std::uint64_t const first = places.first();
    return orderAt(a, b, first < front ? first : length - 2 * front + first);
}

#endif

} // namespace

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

bool sameTexts(char const* a, char const* b, std::uint64_t length) noexcept { return same<Given>(a, b, length); }

bool sameOwnedTexts(char const* a, char const* b, std::uint64_t length) noexcept { return same<Owned>(a, b, length); }

int compareTexts(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept {
    return order<Given>(a, aSize, b, bSize);
}

int compareOwnedTexts(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept {
    return order<Owned>(a, aSize, b, bSize);
}

#else

bool sameTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    return compareTextsUpTo(a, b, length) == 0;
}

bool sameOwnedTexts(char const* a, char const* b, std::uint64_t length) noexcept { return sameTexts(a, b, length); }

int compareTexts(char const* a, std::uint64_t, char const* b, std::uint64_t) noexcept { return compareTexts(a, b); }

int compareOwnedTexts(char const* a, std::uint64_t, char const* b, std::uint64_t) noexcept {
    return compareTexts(a, b);
}

#endif

} // namespace ZOR_Basis::detail
