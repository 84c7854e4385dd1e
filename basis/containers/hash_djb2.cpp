#include "zor_basis/containers/hashing.h"

#include <emmintrin.h>

#include <array>
#include <bit>
#include <cstdint>

// The hash of a text is 33^n times the start, plus the sum of its bytes weighted with falling powers of 33. Sixteen bytes
// are weighted at once. The last block is filled with zeros, which weights its bytes too high by a power of 33; as 33 is
// odd, that power has an inverse modulo 2^64.

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

/// Byte i of sixteen, signed, times 33^(15 - i), summed.
std::uint64_t weighted(__m128i bytes) {
    // kept hash-01: the sign of each byte is extended.
    __m128i const signs = _mm_cmpgt_epi8(_mm_setzero_si128(), bytes);
    __m128i const byPair = _mm_set1_epi32(1 << 16 | static_cast<int>(POWER[1]));
    __m128i const low = _mm_madd_epi16(_mm_unpacklo_epi8(bytes, signs), byPair);
    __m128i const high = _mm_madd_epi16(_mm_unpackhi_epi8(bytes, signs), byPair);
    __m128i const byGroup = _mm_set1_epi32(1 << 16 | static_cast<int>(POWER[2]));
    __m128i const groups = _mm_madd_epi16(_mm_packs_epi32(low, high), byGroup);
    // Four groups of four bytes, each as far as 32 bits reach.
    std::int64_t const front = _mm_cvtsi128_si64(groups);
    std::int64_t const back = _mm_cvtsi128_si64(_mm_unpackhi_epi64(groups, groups));
    return signExtended(static_cast<std::int32_t>(front)) * POWER[12] + signExtended(front >> 32) * POWER[8] +
           (signExtended(static_cast<std::int32_t>(back)) * POWER[4] + signExtended(back >> 32));
}

__m128i load(char const* p) { return _mm_loadu_si128(reinterpret_cast<__m128i const*>(p)); }

/// Sixteen bytes of a text; behind its terminator anything. What lies in the page of the first byte can be read.
#if defined(__GNUC__)
[[gnu::no_sanitize_address]]
#endif
inline __m128i
loadText(char const* text) {
    if (reinterpret_cast<std::uintptr_t>(text) % PAGE <= PAGE - BLOCK) {
        return _mm_loadu_si128(reinterpret_cast<__m128i const*>(text)); // not load(): that one is sanitized
    }
    char bytes[BLOCK] = {};
    for (unsigned i = 0; i < BLOCK && text[i] != '\0'; ++i) bytes[i] = text[i];
    return load(bytes);
}

/// The first `count` bytes, zeros behind them.
__m128i firstBytes(__m128i bytes, unsigned count) {
    alignas(BLOCK) static constexpr char MASK[2 * BLOCK] = {-1, -1, -1, -1, -1, -1, -1, -1,
                                                            -1, -1, -1, -1, -1, -1, -1, -1};
    return _mm_and_si128(bytes, load(MASK + BLOCK - count));
}

} // namespace

std::uint64_t hashDjb2(char const* text, std::uint64_t) noexcept {
    if (text == nullptr) return START;
    std::uint64_t hash = START;
    for (;; text += BLOCK) {
        __m128i const bytes = loadText(text);
        auto const zeros = static_cast<unsigned>(_mm_movemask_epi8(_mm_cmpeq_epi8(bytes, _mm_setzero_si128())));
        if (zeros != 0) {
            auto const count = static_cast<unsigned>(std::countr_zero(zeros));
            if (count == 0) return hash;
            return hash * POWER[count] + weighted(firstBytes(bytes, count)) * INVERSE_POWER[BLOCK - count];
        }
        hash = hash * POWER[BLOCK] + weighted(bytes);
    }
}

} // namespace ZOR_Basis
