/// \file
/// Two narrow texts side by side in vectors of 64 bytes, for processors with AVX-512BW.

#ifndef BASIS_TEXT_WIDE_TEXT_PAIR_H
#define BASIS_TEXT_WIDE_TEXT_PAIR_H

#include "basis/text/text_pair.h"

#include <cstdint>
#include <limits>

#if ZB_WIDE_VECTOR_TEXT

namespace ZOR_Basis::detail {

using WidePlaces = Places<std::uint64_t>;

ZB_AVX512 ZB_INLINE WidePlaces placesOf(__m512i a, __m512i b) noexcept {
    std::uint64_t const different = _mm512_cmpneq_epi8_mask(a, b);
    return {different, different | _mm512_testn_epi8_mask(a, a)};
}

/// Of 64 bytes.
ZB_AVX512 ZB_INLINE WidePlaces widePlaces(char const* a, char const* b) noexcept {
    return placesOf(_mm512_loadu_si512(a), _mm512_loadu_si512(b));
}

/// Of 1 to 64 bytes, behind which both texts look as if they ended.
ZB_AVX512 ZB_INLINE WidePlaces widePlaces(char const* a, char const* b, std::uint64_t length) noexcept {
    __mmask64 const bytes = ~std::uint64_t{0} >> (64 - length);
    return placesOf(_mm512_maskz_loadu_epi8(bytes, a), _mm512_maskz_loadu_epi8(bytes, b));
}

/// Where two texts of more than 64 bytes are decided. They go in runs of 64, of which the last begins in the one before,
/// with a branch for each: texts that differ mostly do so early.
template <class Text>
class WideRuns {
public:
    // What the place is where they are the same and go on, or not all of them may be read.
    static constexpr std::uint64_t Nowhere = std::numeric_limits<std::uint64_t>::max();
    static constexpr std::uint64_t Unreadable = Nowhere - 1;

    ZB_AVX512 ZB_INLINE WideRuns(char const* a, char const* b, std::uint64_t length) noexcept
        : a_(a), b_(b), length_(length) {}

    /// The first place where they differ or end.
    ZB_AVX512 ZB_INLINE std::uint64_t decidedPlace() noexcept {
        if (isDecidedAt(0)) return place_;
        if (length_ > 128) {
            if (isDecidedAt(64)) return place_;
            for (std::uint64_t done = 128; length_ - done > 128; done += 64) {
                if (isDecidedAt(done)) return place_;
            }
            if (isDecidedAt(length_ - 128)) return place_;
        }
        return isDecidedAt(length_ - 64) ? place_ : Nowhere;
    }

private:
    ZB_AVX512 ZB_INLINE bool isDecidedAt(std::uint64_t run) noexcept {
        if (!Text::readable(a_ + run, b_ + run, 64)) {
            place_ = Unreadable;
            return true;
        }
        WidePlaces const places = widePlaces(a_ + run, b_ + run);
        if (places.decided == 0) return false;
        place_ = run + places.first();
        return true;
    }

    char const* a_;
    char const* b_;
    std::uint64_t length_;
    std::uint64_t place_ = Nowhere;
};

/// More than 64 bytes.
template <class Text>
ZB_AVX512 ZB_COLD bool sameInWideRuns(char const* a, char const* b, std::uint64_t length) noexcept {
    std::uint64_t const place = WideRuns<Text>(a, b, length).decidedPlace();
    if (place == WideRuns<Text>::Nowhere) return true;
    if (place == WideRuns<Text>::Unreadable) return sameByRuntime(a, b, length);
    return a[place] == b[place];
}

template <class Text>
ZB_AVX512 ZB_COLD int orderInWideRuns(char const* a, char const* b, std::uint64_t length) noexcept {
    std::uint64_t const place = WideRuns<Text>(a, b, length).decidedPlace();
    if (place == WideRuns<Text>::Nowhere) return orderAtTheEnd(a + length, b + length);
    if (place == WideRuns<Text>::Unreadable) return orderByRuntime(a, b);
    return orderAt(a, b, place);
}

/// 1 to 64 bytes that may be read.
ZB_AVX512 ZB_COLD inline int orderInOneRun(char const* a, char const* b, std::uint64_t length) noexcept {
    std::uint64_t const place = widePlaces(a, b, length).first();
    return place < length ? orderAt(a, b, place) : orderAtTheEnd(a + length, b + length);
}

} // namespace ZOR_Basis::detail

#endif

#endif
