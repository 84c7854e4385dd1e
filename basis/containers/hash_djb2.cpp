#include "zor_basis/containers/hashing.h"

#include <emmintrin.h>

#include <cstring>

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t START = 5381;
constexpr std::uint64_t FACTOR = 33;

constexpr std::uint64_t power(unsigned exponent) {
    std::uint64_t value = 1;
    while (exponent-- > 0) value *= FACTOR;
    return value;
}

/// Bytes of one step: sums of 4 bytes each in 32 bits, weighted with powers of 33, which is as far as 32 bits reach.
constexpr unsigned BLOCK = 16;
constexpr unsigned GROUP = 4;

/// The hash is 33^BLOCK times what was before, plus the weighted sum of the block's bytes.
std::uint64_t addBlock(std::uint64_t hash, char const* text) {
    __m128i const bytes = _mm_loadu_si128(reinterpret_cast<__m128i const*>(text));
    // kept hash-01: the sign of each byte is extended.
    __m128i const signs = _mm_cmpgt_epi8(_mm_setzero_si128(), bytes);
    __m128i const byPair = _mm_set1_epi32(1 << 16 | static_cast<int>(FACTOR));
    __m128i const low = _mm_madd_epi16(_mm_unpacklo_epi8(bytes, signs), byPair);
    __m128i const high = _mm_madd_epi16(_mm_unpackhi_epi8(bytes, signs), byPair);
    __m128i const byGroup = _mm_set1_epi32(1 << 16 | static_cast<int>(power(2)));
    __m128i const groups = _mm_madd_epi16(_mm_packs_epi32(low, high), byGroup);

    std::int32_t sums[GROUP];
    _mm_storeu_si128(reinterpret_cast<__m128i*>(sums), groups);
    auto const weighted = [&sums](unsigned group, unsigned exponent) {
        return static_cast<std::uint64_t>(static_cast<std::int64_t>(sums[group])) * power(exponent);
    };
    return hash * power(BLOCK) + (weighted(0, 12) + weighted(1, 8)) + (weighted(2, 4) + weighted(3, 0));
}

std::uint64_t addByte(std::uint64_t hash, char byte) {
    return hash * FACTOR + static_cast<std::uint64_t>(static_cast<std::int64_t>(static_cast<signed char>(byte)));
}

std::uint64_t addBytes(std::uint64_t hash, char const* text, std::uint64_t count) {
    for (; count > 0; --count) hash = addByte(hash, *text++);
    return hash;
}

/// The bytes of half a block, weighted one by one so that no product waits for another.
std::uint64_t addHalfBlock(std::uint64_t hash, char const* text) {
    std::uint64_t const front = addBytes(0, text, 4);
    std::uint64_t const back = addBytes(0, text + 4, 4);
    return hash * power(8) + front * power(4) + back;
}

} // namespace

std::uint64_t hashDjb2(char const* text, std::uint64_t) noexcept {
    if (text == nullptr) return START;
    std::uint64_t left = std::strlen(text);
    std::uint64_t hash = START;
    for (; left >= BLOCK; left -= BLOCK, text += BLOCK) hash = addBlock(hash, text);
    if (left >= BLOCK / 2) {
        hash = addHalfBlock(hash, text);
        text += BLOCK / 2;
        left -= BLOCK / 2;
    }
    return addBytes(hash, text, left);
}

} // namespace ZOR_Basis
