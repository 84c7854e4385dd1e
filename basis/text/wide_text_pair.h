/// \file
/// Two narrow texts of more than 64 bytes side by side in vectors of 32 bytes, for processors with AVX2.

#ifndef BASIS_TEXT_WIDE_TEXT_PAIR_H
#define BASIS_TEXT_WIDE_TEXT_PAIR_H

#include "basis/text/text_pair.h"

#include <bit>
#include <cstdint>

#if ZB_WIDE_VECTOR_TEXT

namespace ZOR_Basis::detail {

/// See `NarrowRun`.
struct WideRun {
    ZB_AVX2 WideRun(char const* a, char const* b) noexcept : low(openIn(a, b)), high(openIn(a + 32, b + 32)) {}

    ZB_AVX2 __m256i least() const noexcept { return _mm256_min_epu8(low, high); }
    ZB_AVX2 bool isDecided() const noexcept { return hasZero(least()); }
    ZB_AVX2 bool isDecidedWith(WideRun const& next) const noexcept {
        return hasZero(_mm256_min_epu8(least(), next.least()));
    }
    ZB_AVX2 std::uint64_t firstPlace() const noexcept {
        return static_cast<std::uint64_t>(std::countr_zero(zerosIn(low) | std::uint64_t{zerosIn(high)} << 32));
    }

    __m256i low;
    __m256i high;

private:
    ZB_AVX2 static __m256i openIn(char const* a, char const* b) noexcept {
        __m256i bytes = load32(a);
        ZB_ONE_LOAD(bytes);
        return _mm256_min_epu8(bytes, _mm256_cmpeq_epi8(bytes, load32(b)));
    }
};

/// More than 64 bytes that may be read.
ZB_AVX2 ZB_COLD inline bool sameLongByWide(char const* a, char const* b, std::uint64_t length) noexcept {
    return sameLongTexts<WideRun>(a, b, length);
}
ZB_AVX2 ZB_COLD inline int orderOfLongByWide(char const* a, char const* b, std::uint64_t length) noexcept {
    return orderOfLongTexts<WideRun>(a, b, length);
}

} // namespace ZOR_Basis::detail

#endif

#endif
