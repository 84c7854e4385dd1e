/// \file
/// Sixteen bytes of text at a time, for the conversions between UTF-8 and UTF-16. Needs SSE2, which every x64 has; where
/// bytes are dropped from a block, it takes SSSE3, and processors without it go character by character. AVX2 is used for
/// long runs.

#ifndef BASIS_TEXT_UTF_BLOCK_H
#define BASIS_TEXT_UTF_BLOCK_H

#include "zor_basis/wide_char.h"

#include <array>
#include <bit>
#include <cstdint>
#include <cstring>

#if defined(__GNUC__)
#include <immintrin.h>
#define ZB_SHUFFLE_TARGET __attribute__((target("ssse3")))
#define ZB_WIDE_TARGET __attribute__((target("avx2")))
#define ZB_IN_CALLER [[gnu::always_inline]] inline
#define ZB_CAN_SHUFFLE (__builtin_cpu_supports("ssse3") != 0)
#define ZB_CAN_WIDE (__builtin_cpu_supports("avx2") != 0)
#else
#include <immintrin.h>
#define ZB_SHUFFLE_TARGET
#define ZB_WIDE_TARGET
#define ZB_IN_CALLER inline
#define ZB_CAN_SHUFFLE false
#define ZB_CAN_WIDE false
#endif

namespace ZOR_Basis::Utf {

inline constexpr std::uint64_t BLOCK_BYTES = 16;
inline constexpr std::uint64_t BLOCK_UNITS = BLOCK_BYTES / sizeof(WChar);

inline __m128i loadBlock(void const* from) { return _mm_loadu_si128(static_cast<__m128i const*>(from)); }
inline void storeBlock(void* to, __m128i block) { _mm_storeu_si128(static_cast<__m128i*>(to), block); }
inline void storeHalfBlock(void* to, __m128i block) { _mm_storel_epi64(static_cast<__m128i*>(to), block); }

/// Blocks of twice the size, for functions that run only where the processor has them.
inline constexpr std::uint64_t LEAST_WIDE_UNITS = 64; // shorter texts do not repay what they cost to start
ZB_WIDE_TARGET inline __m256i loadWideBlock(void const* from) {
    return _mm256_loadu_si256(static_cast<__m256i const*>(from));
}
ZB_WIDE_TARGET inline void storeWideBlock(void* to, __m256i block) {
    _mm256_storeu_si256(static_cast<__m256i*>(to), block);
}

inline unsigned bitsOf(__m128i mask) { return static_cast<unsigned>(_mm_movemask_epi8(mask)); }

/// The sum of the sixteen bytes.
inline std::uint64_t sumOfBytes(__m128i block) {
    __m128i const halves = _mm_sad_epu8(block, _mm_setzero_si128());
    return static_cast<std::uint64_t>(_mm_cvtsi128_si64(halves)) +
           static_cast<std::uint64_t>(_mm_cvtsi128_si64(_mm_unpackhi_epi64(halves, halves)));
}

template <class Word>
Word loadWord(void const* from) {
    Word word;
    std::memcpy(&word, from, sizeof word);
    return word;
}

template <class Word>
void storeWord(void* to, Word word) {
    std::memcpy(to, &word, sizeof word);
}

/// For each choice among a block's eight units: where the bytes that stay come from, and how many they are.
struct Selection {
    std::array<std::array<std::uint8_t, BLOCK_BYTES>, 256> places;
    std::array<std::uint8_t, 256> sizes;
};

/// \param keptOfChosen, keptOfOthers  the bytes that stay of a unit whose bit is set and of one whose bit is not
constexpr Selection makeSelection(unsigned keptOfChosen, unsigned keptOfOthers) {
    Selection selection{};
    for (unsigned choice = 0; choice < 256; ++choice) {
        unsigned size = 0;
        for (unsigned unit = 0; unit < BLOCK_UNITS; ++unit) {
            unsigned const kept = (choice >> unit & 1) != 0 ? keptOfChosen : keptOfOthers;
            for (unsigned byte = 0; byte < kept; ++byte)
                selection.places[choice][size++] = static_cast<std::uint8_t>(2 * unit + byte);
        }
        selection.sizes[choice] = static_cast<std::uint8_t>(size);
    }
    return selection;
}

/// Stores the bytes of a block that a selection keeps. \return how many
ZB_SHUFFLE_TARGET inline unsigned storeSelected(void* to, __m128i block, unsigned choice, Selection const& selection) {
    storeBlock(to, _mm_shuffle_epi8(block, loadBlock(selection.places[choice].data())));
    return selection.sizes[choice];
}

} // namespace ZOR_Basis::Utf

#endif
