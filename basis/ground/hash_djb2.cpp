#include "basis/ground/processor.h"
#include "basis/ground/wide_loads.h"
#include "zor_basis/ground/hashing.h"

#include <array>
#include <bit>
#include <cstdint>

// The hash of a text is 33^n times the start, plus the sum of its bytes weighted with falling powers of 33. Sixteen
// bytes are weighted in one step. The last block is filled with zeros, which weights its bytes too high by a power of
// 33; as 33 is odd, that power has an inverse modulo 2^64.

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t START = 5381;
constexpr std::uint64_t FACTOR = 33;
constexpr unsigned BLOCK = 16;
constexpr std::uintptr_t PAGE = 4096;

constexpr std::uint64_t inverse(std::uint64_t odd) {
    std::uint64_t x = odd; // right in the last 3 bits; each step doubles how many are
    for (int step = 0; step < 5; ++step) x *= 2 - odd * x;
    return x;
}
static_assert(FACTOR * inverse(FACTOR) == 1);

constexpr std::array<std::uint64_t, BLOCK + 1> powersOf(std::uint64_t factor) {
    std::array<std::uint64_t, BLOCK + 1> powers{1};
    for (unsigned i = 1; i <= BLOCK; ++i) powers[i] = powers[i - 1] * factor;
    return powers;
}
constexpr auto POWER = powersOf(FACTOR);
constexpr auto INVERSE_POWER = powersOf(inverse(FACTOR));

std::uint64_t signExtended(std::int64_t value) { return static_cast<std::uint64_t>(value); }

constexpr int weights(std::uint64_t first, std::uint64_t second) { return static_cast<int>(second << 16 | first); }

// How pairs of bytes are weighted: eight sums of 33 times the first, plus the second.
struct ByMultiplication {
    ZB_INLINE static __m128i pairs(__m128i bytes) {
        // kept hash-01: the sign of each byte is extended.
        __m128i const signs = _mm_cmpgt_epi8(_mm_setzero_si128(), bytes);
        __m128i const byPair = _mm_set1_epi32(weights(POWER[1], 1));
        return _mm_packs_epi32(_mm_madd_epi16(_mm_unpacklo_epi8(bytes, signs), byPair),
                               _mm_madd_epi16(_mm_unpackhi_epi8(bytes, signs), byPair));
    }
};
struct BySsse3 {
    ZB_SSSE3 static __m128i pairs(__m128i bytes) {
        // kept hash-01: the second operand's bytes are signed.
        return _mm_maddubs_epi16(_mm_set1_epi16(static_cast<short>(1 << 8 | POWER[1])), bytes);
    }
};

/// Sixteen bytes in four groups, each weighted within itself; 32 bits hold it.
template <class Pairs>
ZB_INLINE __m128i byGroups(__m128i bytes) {
    return _mm_madd_epi16(Pairs::pairs(bytes), _mm_set1_epi32(weights(POWER[2], 1)));
}

/// Byte i of sixteen, signed, times 33^(15 - i), summed.
template <class Pairs>
ZB_INLINE std::uint64_t weighted(__m128i bytes) {
    __m128i const groups = byGroups<Pairs>(bytes);
    std::int64_t const front = _mm_cvtsi128_si64(groups);
    std::int64_t const back = _mm_cvtsi128_si64(_mm_unpackhi_epi64(groups, groups));
    return signExtended(static_cast<std::int32_t>(front)) * POWER[12] + signExtended(front >> 32) * POWER[8] +
           (signExtended(static_cast<std::int32_t>(back)) * POWER[4] + signExtended(back >> 32));
}

using detail::load16;
using detail::zerosIn;

/// Sixteen bytes of a text; behind its terminator anything. What lies in the page of the first byte can be read.
ZB_UNSANITIZED inline __m128i loadText(char const* text) {
    if (reinterpret_cast<std::uintptr_t>(text) % PAGE <= PAGE - BLOCK) [[likely]]
        return load16(text);
    char bytes[BLOCK] = {};
    for (unsigned i = 0; i < BLOCK && text[i] != '\0'; ++i) bytes[i] = text[i];
    return load16(bytes);
}

/// The first `count` bytes, zeros behind them.
__m128i firstBytes(__m128i bytes, unsigned count) {
    alignas(BLOCK) static constexpr char MASK[2 * BLOCK] = {-1, -1, -1, -1, -1, -1, -1, -1,
                                                            -1, -1, -1, -1, -1, -1, -1, -1};
    return _mm_and_si128(bytes, load16(MASK + BLOCK - count));
}

/// \param bytes  the first sixteen of the text, or what `loadText` gives for them
template <class Pairs>
ZB_INLINE std::uint64_t hashOf(char const* text, __m128i bytes) {
    std::uint64_t hash = START;
    for (;; bytes = loadText(text += BLOCK)) {
        unsigned const zeros = zerosIn(bytes);
        if (zeros != 0) {
            auto const count = static_cast<unsigned>(std::countr_zero(zeros));
            if (count == 0) return hash;
            return hash * POWER[count] + weighted<Pairs>(firstBytes(bytes, count)) * INVERSE_POWER[BLOCK - count];
        }
        hash = hash * POWER[BLOCK] + weighted<Pairs>(bytes);
    }
}

constexpr unsigned SHORT = 8;

/// Of the first `count` of sixteen bytes, at most SHORT.
ZB_INLINE std::uint64_t hashOfShort(__m128i bytes, unsigned count) {
    // Zeros in front of the text weigh nothing. In two steps, as all bits may go.
    unsigned const half = 4 * (SHORT - count);
    auto const last = static_cast<std::uint64_t>(_mm_cvtsi128_si64(bytes)) << half << half;
    __m128i const groups = byGroups<ByMultiplication>(_mm_cvtsi64_si128(static_cast<std::int64_t>(last)));
    std::int64_t const both = _mm_cvtsi128_si64(groups);
    return START * POWER[count] + signExtended(static_cast<std::int32_t>(both)) * POWER[4] + signExtended(both >> 32);
}

ZB_SSSE3 std::uint64_t hashBySsse3(char const* text, __m128i bytes) { return hashOf<BySsse3>(text, bytes); }

} // namespace

std::uint64_t hashDjb2(char const* text, std::uint64_t) noexcept {
    if (text == nullptr) [[unlikely]]
        return START;
    __m128i const bytes = loadText(text);
    unsigned const zeros = zerosIn(bytes) & ((2U << SHORT) - 1);
    if (zeros != 0) [[likely]]
        return hashOfShort(bytes, static_cast<unsigned>(std::countr_zero(zeros)));
    return detail::canUse(detail::Vectors::SSSE3) ? hashBySsse3(text, bytes) : hashOf<ByMultiplication>(text, bytes);
}

} // namespace ZOR_Basis
