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

/// Of 32 places, a bit each.
constexpr unsigned AllSame = 0xFFFFFFFF;

/// Two texts of 17 to 64 bytes in four vectors, which overlap each other in shorter ones. They are compared as memory
/// first. Only where they differ does it matter whether they ended before that; such texts are rare, and the runtime
/// compares them.
class MediumTexts {
public:
    ZB_INLINE MediumTexts(char const* a, char const* b, std::uint64_t length) noexcept
        : second_(std::min<std::uint64_t>(16, length - 16)), last_(length - 16) {
        compare(0, a, b, 0);
        compare(1, a, b, second_);
        compare(2, a, b, last_ - second_);
        compare(3, a, b, last_);
    }

    ZB_INLINE bool same() const noexcept {
        __m128i const all = _mm_and_si128(_mm_and_si128(same_[0], same_[1]), _mm_and_si128(same_[2], same_[3]));
        return _mm_movemask_epi8(all) == 0xFFFF;
    }
    ZB_INLINE bool haveZero() const noexcept {
        return zerosOf(_mm_min_epu8(_mm_min_epu8(bytes_[0], bytes_[1]), _mm_min_epu8(bytes_[2], bytes_[3]))) != 0;
    }
    /// The place of the first difference; where there is none, the length.
    ZB_INLINE std::uint64_t difference() const noexcept {
        unsigned const front = samePlaces(0) | samePlaces(1) << 16;
        if (front != AllSame) {
            auto const place = static_cast<std::uint64_t>(std::countr_one(front));
            return place < 16 ? place : place - 16 + second_;
        }
        unsigned const back = samePlaces(2) | samePlaces(3) << 16;
        auto const place = static_cast<std::uint64_t>(std::countr_one(back));
        return place < 16 ? place + last_ - second_ : place - 16 + last_;
    }

private:
    ZB_INLINE void compare(unsigned i, char const* a, char const* b, std::uint64_t place) noexcept {
        bytes_[i] = load16(a + place);
        same_[i] = _mm_cmpeq_epi8(bytes_[i], load16(b + place));
    }
    ZB_INLINE unsigned samePlaces(unsigned i) const noexcept {
        return static_cast<unsigned>(_mm_movemask_epi8(same_[i]));
    }

    std::uint64_t second_;
    std::uint64_t last_;
    __m128i bytes_[4];
    __m128i same_[4];
};

#if ZB_WIDE_VECTOR_TEXT

// What a place is where there is none: the texts do not differ, or not all of them may be read.
constexpr std::uint64_t Nowhere = std::numeric_limits<std::uint64_t>::max();
constexpr std::uint64_t Unreadable = Nowhere - 1;

/// Two texts of more than 64 bytes, in the same way.
class LongTexts {
public:
    ZB_AVX2 ZB_INLINE LongTexts(char const* a, char const* b, std::uint64_t length) noexcept
        : a_(a), b_(b), length_(length), least_(_mm256_set1_epi8(-1)) {}

    /// Where a run of vectors begins that are not all the same.
    template <class Text>
    ZB_AVX2 ZB_INLINE std::uint64_t difference() noexcept {
        constexpr std::uint64_t Run = 128;
        std::uint64_t done = 0;
        for (; length_ - done > Run; done += Run) {
            if (!Text::readable(a_ + done, b_ + done, Run)) return Unreadable;
            if (!sameFour(done, done + 64)) return done;
        }
        if (!Text::readable(a_ + done, b_ + done, length_ - done)) return Unreadable;
        // The last run of a longer text begins in the one before.
        if (length_ > Run) return sameFour(length_ - Run, length_ - 64) ? Nowhere : done;
        return sameFour(0, length_ - 64) ? Nowhere : 0;
    }

    /// Whether a zero is among the bytes looked at so far.
    ZB_AVX2 ZB_INLINE bool haveZero() const noexcept { return hasZero(least_); }

    /// The place of the first difference. \pre there is one behind `place`
    ZB_AVX2 ZB_INLINE std::uint64_t firstFrom(std::uint64_t place) const noexcept {
        for (;; place += 32) {
            place = std::min(place, length_ - 32);
            unsigned const same = sameBytes(load32(a_ + place), place);
            if (same != AllSame) return place + static_cast<std::uint64_t>(std::countr_one(same));
        }
    }

private:
    ZB_AVX2 ZB_INLINE __m256i compared(__m256i bytes, std::uint64_t place) const noexcept {
        return _mm256_cmpeq_epi8(bytes, load32(b_ + place));
    }
    ZB_AVX2 ZB_INLINE unsigned sameBytes(__m256i bytes, std::uint64_t place) const noexcept {
        return static_cast<unsigned>(_mm256_movemask_epi8(compared(bytes, place)));
    }
    ZB_AVX2 ZB_INLINE bool sameFour(std::uint64_t head, std::uint64_t tail) noexcept {
        __m256i const v0 = load32(a_ + head);
        __m256i const v1 = load32(a_ + head + 32);
        __m256i const v2 = load32(a_ + tail);
        __m256i const v3 = load32(a_ + tail + 32);
        least_ = _mm256_min_epu8(least_, _mm256_min_epu8(_mm256_min_epu8(v0, v1), _mm256_min_epu8(v2, v3)));
        __m256i const front = _mm256_and_si256(compared(v0, head), compared(v1, head + 32));
        __m256i const back = _mm256_and_si256(compared(v2, tail), compared(v3, tail + 32));
        return static_cast<unsigned>(_mm256_movemask_epi8(_mm256_and_si256(front, back))) == AllSame;
    }

    char const* a_;
    char const* b_;
    std::uint64_t length_;
    __m256i least_;
};

template <class Text>
ZB_AVX2 ZB_COLD bool sameLongTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    LongTexts texts(a, b, length);
    std::uint64_t const run = texts.difference<Text>();
    if (run == Nowhere) return true;
    return (run == Unreadable || texts.haveZero()) && sameByRuntime(a, b, length);
}

/// How texts compare that are likely to end there.
template <class Text>
ZB_AVX2 ZB_COLD int orderOfLongTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    LongTexts texts(a, b, length);
    std::uint64_t const run = texts.difference<Text>();
    if (run == Unreadable || texts.haveZero()) return orderByRuntime(a, b);
    return run == Nowhere ? orderAtTheEnd(a + length, b + length) : orderAt(a, b, texts.firstFrom(run));
}

#endif

/// More than 64 bytes.
template <class Text>
ZB_INLINE bool sameLong(char const* a, char const* b, std::uint64_t length) noexcept {
#if ZB_WIDE_VECTOR_TEXT
    if (__builtin_cpu_supports("avx2")) [[likely]]
        return sameLongTexts<Text>(a, b, length);
#endif
    return sameByRuntime(a, b, length);
}

template <class Text>
ZB_INLINE bool same(char const* a, char const* b, std::uint64_t length) noexcept {
    if (length > 64) [[unlikely]]
        return sameLong<Text>(a, b, length);
    if (!Text::readable(a, b, length)) [[unlikely]]
        return sameByRuntime(a, b, length);
    if (length > 16) [[likely]] {
        MediumTexts const texts(a, b, length);
        if (texts.same()) [[likely]]
            return true;
        return texts.haveZero() && sameByRuntime(a, b, length);
    }
    if (length >= 8) return placesOf(ends8To16(a, length), ends8To16(b, length)).same();
    if (length >= 4) return placesOf(ends4To7(a, length), ends4To7(b, length)).same();
    return length == 0 || placesOf(ends1To3(a, length), ends1To3(b, length)).same();
}

/// 4 to 16 bytes.
ZB_INLINE int orderOfShortTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    std::uint64_t const front = length >= 8 ? 8 : 4; // places from the first end of the texts
    auto places = front == 8 ? placesOf(ends8To16(a, length), ends8To16(b, length))
                             : placesOf(ends4To7(a, length), ends4To7(b, length));
    if (front == 4) places.decided &= 0xFFU;
    if (places.decided == 0) return orderAtTheEnd(a + length, b + length);
    std::uint64_t const first = places.first();
    return orderAt(a, b, first < front ? first : length - 2 * front + first);
}

/// More than 64 bytes.
template <class Text>
ZB_INLINE int orderOfLong(char const* a, char const* b, std::uint64_t length) noexcept {
#if ZB_WIDE_VECTOR_TEXT
    if (__builtin_cpu_supports("avx2")) [[likely]]
        return orderOfLongTexts<Text>(a, b, length);
#endif
    return orderByRuntime(a, b);
}

template <class Text>
ZB_INLINE int order(char const* a, std::uint64_t aSize, char const* b, std::uint64_t bSize) noexcept {
    std::uint64_t const length = std::min(aSize, bSize); // where the shorter one is likely to end
    if (length > 64) [[unlikely]]
        return orderOfLong<Text>(a, b, length);
    if (length < 4 || !Text::readable(a, b, length)) [[unlikely]]
        return orderByRuntime(a, b);
    if (length <= 16) [[unlikely]]
        return orderOfShortTexts(a, b, length);
    MediumTexts const texts(a, b, length);
    if (texts.haveZero()) [[unlikely]]
        return orderByRuntime(a, b);
    std::uint64_t const place = texts.difference();
    return place == length ? orderAtTheEnd(a + length, b + length) : orderAt(a, b, place);
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
