/// \file
/// Sixteen bytes of text at a time, for the conversions between UTF-8 and UTF-16. Needs SSE2, which every x64 has;
/// where bytes are dropped from a block, it takes SSSE3, and processors without it go character by character. AVX2 is
/// used for long runs.

#ifndef BASIS_TEXT_UTF_BLOCK_H
#define BASIS_TEXT_UTF_BLOCK_H

#include "basis/ground/wide_loads.h"
#include "zor_basis/wide_char.h"

#include <array>
#include <cstdint>

namespace ZOR_Basis::Utf {

inline constexpr std::uint64_t BLOCK_BYTES = 16;
inline constexpr std::uint64_t BLOCK_UNITS = BLOCK_BYTES / sizeof(WChar);

/// Shorter texts do not repay what longer vectors cost to start.
inline constexpr std::uint64_t LEAST_WIDE_UNITS = 64;

using detail::bitsOf;
using detail::hasZero;
using detail::load16;
using detail::load32;
using detail::loadWord;
using detail::store16;
using detail::store32;
using detail::store8;
using detail::storeWord;

/// The sum of the sixteen bytes.
inline std::uint64_t sumOfBytes(__m128i block) {
    __m128i const halves = _mm_sad_epu8(block, _mm_setzero_si128());
    return static_cast<std::uint64_t>(_mm_cvtsi128_si64(halves)) +
           static_cast<std::uint64_t>(_mm_cvtsi128_si64(_mm_unpackhi_epi64(halves, halves)));
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

/// Stores the bytes of a block that a selection keeps.
/// \return how many
ZB_SSSE3 inline unsigned storeSelected(void* to, __m128i block, unsigned choice, Selection const& selection) {
    store16(to, _mm_shuffle_epi8(block, load16(selection.places[choice].data())));
    return selection.sizes[choice];
}

} // namespace ZOR_Basis::Utf

#endif
