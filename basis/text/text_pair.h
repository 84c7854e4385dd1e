/// \file
/// Two narrow texts side by side in vectors of 16 bytes, up to a common terminator. "May be read" says that all bytes
/// of a length are readable, whatever lies among them.

#ifndef BASIS_TEXT_TEXT_PAIR_H
#define BASIS_TEXT_TEXT_PAIR_H

#include "basis/text/vector_text.h"

#include <algorithm>
#include <bit>
#include <cstdint>
#include <cstring>

namespace ZOR_Basis::detail {

template <class Char>
Char const* textOrEmpty(Char const* text) noexcept {
    static constexpr Char EMPTY[1] = {};
    return text != nullptr ? text : EMPTY;
}

#if ZB_VECTOR_TEXT

ZB_COLD inline bool sameByRuntime(char const* a, char const* b, std::uint64_t length) noexcept {
    return std::strncmp(textOrEmpty(a), textOrEmpty(b), length) == 0;
}

ZB_COLD inline int orderByRuntime(char const* a, char const* b) noexcept {
    return std::strcmp(textOrEmpty(a), textOrEmpty(b));
}

inline int orderAt(char const* a, char const* b, std::uint64_t place) noexcept {
    return static_cast<int>(static_cast<unsigned char>(a[place])) -
           static_cast<int>(static_cast<unsigned char>(b[place]));
}

/// Of texts that are equal so far and have not ended.
inline int orderAtTheEnd(char const* a, char const* b) noexcept {
    if (*a == *b && *a != '\0') [[unlikely]]
        return orderByRuntime(a, b);
    return orderAt(a, b, 0);
}

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
    return {bitsOf(equal) ^ 0xFFFFU, zerosIn(_mm_min_epu8(equal, a))};
}

/// How much of two texts may be read before anything is known about their bytes.
struct GivenPair {
    static bool readable(char const* a, char const* b, std::uint64_t length) noexcept {
        return length <= PAGE_BYTES && inOnePage(a, length) && inOnePage(b, length);
    }
};
struct OwnedPair {
    static bool readable(char const*, char const*, std::uint64_t) noexcept { return true; }
};

// Both ends of a text in one vector. Where they do not fill it, the texts look as if they ended together.
inline __m128i ends1To3(char const* text, std::uint64_t length) noexcept {
    auto const byte = [text](std::uint64_t i) { return static_cast<int>(static_cast<unsigned char>(text[i])); };
    return _mm_cvtsi32_si128(byte(0) | byte(length / 2) << 8 | byte(length - 1) << 16);
}
inline __m128i ends4To7(char const* text, std::uint64_t length) noexcept {
    return _mm_unpacklo_epi32(_mm_cvtsi32_si128(static_cast<int>(loadWord<std::uint32_t>(text))),
                              _mm_cvtsi32_si128(static_cast<int>(loadWord<std::uint32_t>(text + length - 4))));
}
inline __m128i ends8To16(char const* text, std::uint64_t length) noexcept {
    return _mm_unpacklo_epi64(load8(text), load8(text + length - 8));
}

/// 1 to 16 bytes that may be read.
ZB_INLINE bool sameShortTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    if (length >= 8) return placesOf(ends8To16(a, length), ends8To16(b, length)).same();
    if (length >= 4) return placesOf(ends4To7(a, length), ends4To7(b, length)).same();
    return placesOf(ends1To3(a, length), ends1To3(b, length)).same();
}

/// 4 to 16 bytes that may be read.
ZB_INLINE int orderOfShortTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    std::uint64_t const front = length >= 8 ? 8 : 4; // places from the first end of the texts
    auto places = front == 8 ? placesOf(ends8To16(a, length), ends8To16(b, length))
                             : placesOf(ends4To7(a, length), ends4To7(b, length));
    if (front == 4) places.decided &= 0xFFU;
    if (places.decided == 0) return orderAtTheEnd(a + length, b + length);
    std::uint64_t const first = places.first();
    return orderAt(a, b, first < front ? first : length - 2 * front + first);
}

/// Of 32 places, a bit each.
constexpr unsigned ALL_SAME = 0xFFFFFFFF;

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
        return bitsOf(all) == 0xFFFF;
    }
    ZB_INLINE bool haveZero() const noexcept {
        return hasZero(_mm_min_epu8(_mm_min_epu8(bytes_[0], bytes_[1]), _mm_min_epu8(bytes_[2], bytes_[3])));
    }
    /// The place of the first difference; where there is none, the length.
    ZB_INLINE std::uint64_t difference() const noexcept {
        unsigned const front = samePlaces(0) | samePlaces(1) << 16;
        if (front != ALL_SAME) {
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
    ZB_INLINE unsigned samePlaces(unsigned i) const noexcept { return bitsOf(same_[i]); }

    std::uint64_t second_;
    std::uint64_t last_;
    __m128i bytes_[4];
    __m128i same_[4];
};

/// 17 to 64 bytes that may be read.
ZB_INLINE bool sameMediumTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    MediumTexts const texts(a, b, length);
    if (texts.same()) [[likely]]
        return true;
    return texts.haveZero() && sameByRuntime(a, b, length);
}

ZB_INLINE int orderOfMediumTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    MediumTexts const texts(a, b, length);
    if (texts.haveZero()) [[unlikely]]
        return orderByRuntime(a, b);
    std::uint64_t const place = texts.difference();
    return place == length ? orderAtTheEnd(a + length, b + length) : orderAt(a, b, place);
}

/// 64 bytes of two texts side by side. A byte of `open` is zero where the texts differ or end.
struct NarrowRun {
    NarrowRun(char const* a, char const* b) noexcept {
        for (int i = 0; i < 4; ++i) {
            __m128i const bytes = load16(a + 16 * i);
            open[i] = _mm_min_epu8(bytes, _mm_cmpeq_epi8(bytes, load16(b + 16 * i)));
        }
    }
    __m128i least() const noexcept {
        return _mm_min_epu8(_mm_min_epu8(open[0], open[1]), _mm_min_epu8(open[2], open[3]));
    }
    bool isDecided() const noexcept { return hasZero(least()); }
    bool isDecidedWith(NarrowRun const& next) const noexcept { return hasZero(_mm_min_epu8(least(), next.least())); }
    std::uint64_t firstPlace() const noexcept {
        std::uint64_t const low = zerosIn(open[0]) | zerosIn(open[1]) << 16;
        std::uint64_t const high = zerosIn(open[2]) | zerosIn(open[3]) << 16;
        return static_cast<std::uint64_t>(std::countr_zero(low | high << 32));
    }

    __m128i open[4];
};

/// The first place at which two texts of more than 64 bytes differ or end; where there is none, the length. Texts that
/// differ mostly do so early, so their first 64 bytes come alone. Then two runs at a time begin where vectors of the
/// first text do not cross a line of the cache; the last ones overlap those before.
template <class Run>
ZB_INLINE std::uint64_t firstDecided(char const* a, char const* b, std::uint64_t length) noexcept {
    constexpr std::uint64_t RUN = 64;
    constexpr std::uint64_t VECTOR = 32;
    Run const front(a, b);
    if (front.isDecided()) return front.firstPlace();
    std::uint64_t at = RUN - reinterpret_cast<std::uintptr_t>(a) % VECTOR;
    for (; length - at > RUN; at += 2 * RUN) {
        at = std::min(at, length - 2 * RUN);
        Run const first(a + at, b + at);
        Run const second(a + at + RUN, b + at + RUN);
        if (first.isDecidedWith(second))
            return first.isDecided() ? at + first.firstPlace() : at + RUN + second.firstPlace();
        if (length - at == 2 * RUN) return length;
    }
    Run const back(a + length - RUN, b + length - RUN);
    return back.isDecided() ? length - RUN + back.firstPlace() : length;
}

template <class Run>
ZB_INLINE bool sameLongTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    std::uint64_t const place = firstDecided<Run>(a, b, length);
    return place == length || a[place] == b[place];
}

template <class Run>
ZB_INLINE int orderOfLongTexts(char const* a, char const* b, std::uint64_t length) noexcept {
    std::uint64_t const place = firstDecided<Run>(a, b, length);
    return place == length ? orderAtTheEnd(a + length, b + length) : orderAt(a, b, place);
}

/// More than 64 bytes that may be read, on every processor.
ZB_COLD inline bool sameLongByNarrow(char const* a, char const* b, std::uint64_t length) noexcept {
    return sameLongTexts<NarrowRun>(a, b, length);
}
ZB_COLD inline int orderOfLongByNarrow(char const* a, char const* b, std::uint64_t length) noexcept {
    return orderOfLongTexts<NarrowRun>(a, b, length);
}

#endif

} // namespace ZOR_Basis::detail

#endif
