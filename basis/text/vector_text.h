/// \file
/// Narrow text in vectors, for copying and comparing without a call of the runtime.
///
/// The text may end before its given length, with nothing readable behind its terminator. So a vector is read only where
/// it lies in the page of its first byte, which is readable, and what does not is left to the runtime. Texts of up to 64
/// bytes are read by vectors that overlap each other; they never reach beyond the given length.

#ifndef BASIS_TEXT_VECTOR_TEXT_H
#define BASIS_TEXT_VECTOR_TEXT_H

#include <cstdint>
#include <cstring>

// A sanitizer that checks addresses has to see every single byte.
#if defined(__SANITIZE_ADDRESS__)
#define ZB_VECTOR_TEXT 0
#elif defined(__has_feature)
#if __has_feature(address_sanitizer)
#define ZB_VECTOR_TEXT 0
#endif
#endif
#if !defined(ZB_VECTOR_TEXT)
#if defined(__x86_64__) || defined(_M_X64)
#define ZB_VECTOR_TEXT 1
#else
#define ZB_VECTOR_TEXT 0
#endif
#endif

// Without optimisation the longer vectors would lie on the stack, which not every compiler aligns for them.
#if ZB_VECTOR_TEXT && defined(__GNUC__) && defined(__OPTIMIZE__)
#define ZB_WIDE_VECTOR_TEXT 1
#include <immintrin.h>
#else
#define ZB_WIDE_VECTOR_TEXT 0
#endif

#if ZB_VECTOR_TEXT
#include <emmintrin.h>

#if defined(__GNUC__)
#define ZB_INLINE [[gnu::always_inline]] inline
#define ZB_COLD [[gnu::noinline]]
#else
#define ZB_INLINE inline
#define ZB_COLD
#endif

namespace ZOR_Basis::detail {

constexpr std::uint64_t PageSize = 4096;

/// Whether so many bytes, at most a page, surely lie in the page of the first one. Never for null.
inline bool inOnePage(void const* text, std::uint64_t length) noexcept {
    return ((reinterpret_cast<std::uintptr_t>(text) - 1) & (PageSize - 1)) < PageSize - length;
}

inline std::uint32_t load4(char const* text) noexcept {
    std::uint32_t bytes;
    std::memcpy(&bytes, text, sizeof bytes);
    return bytes;
}
inline __m128i load8(char const* text) noexcept { return _mm_loadl_epi64(reinterpret_cast<__m128i const*>(text)); }
inline __m128i load16(char const* text) noexcept { return _mm_loadu_si128(reinterpret_cast<__m128i const*>(text)); }
inline void store16(char* target, __m128i bytes) noexcept {
    _mm_storeu_si128(reinterpret_cast<__m128i*>(target), bytes);
}

inline unsigned zerosOf(__m128i bytes) noexcept {
    return static_cast<unsigned>(_mm_movemask_epi8(_mm_cmpeq_epi8(bytes, _mm_setzero_si128())));
}
inline bool hasZero(std::uint64_t bytes) noexcept {
    return ((bytes - 0x0101010101010101U) & ~bytes & 0x8080808080808080U) != 0;
}

#if ZB_WIDE_VECTOR_TEXT

// Longer vectors, in functions of their own that run only where the processor has them.
#define ZB_AVX2 [[gnu::target("avx2")]]
#define ZB_AVX512 [[gnu::target("avx512bw")]]

ZB_AVX2 ZB_INLINE __m256i load32(char const* text) noexcept {
    return _mm256_loadu_si256(reinterpret_cast<__m256i const*>(text));
}
ZB_AVX2 ZB_INLINE void store32(char* target, __m256i bytes) noexcept {
    _mm256_storeu_si256(reinterpret_cast<__m256i*>(target), bytes);
}
ZB_AVX2 ZB_INLINE bool hasZero(__m256i bytes) noexcept {
    return _mm256_movemask_epi8(_mm256_cmpeq_epi8(bytes, _mm256_setzero_si256())) != 0;
}

#endif

} // namespace ZOR_Basis::detail

#endif

#endif
