#include "zor_basis/ground/hashing.h"

#include <bit>

namespace ZOR_Basis {
namespace {

constexpr std::uint32_t PRIMES[] = {
    1,       2,       3,        7,        13,       31,        61,        127,       251,        509,     1021,
    2039,    4093,    8191,     16381,    32749,    65521,     131071,    262139,    524287,     1048573, 2097143,
    4194301, 8388593, 16777213, 33554393, 67108859, 134217689, 268435399, 536870909, 1073741789,
};
static_assert(sizeof(PRIMES) / sizeof(PRIMES[0]) == 31);

} // namespace

std::uint64_t Log2(std::uint64_t n) noexcept { return n != 0 ? static_cast<std::uint64_t>(std::bit_width(n)) - 1 : 0; }

std::uint64_t Pow2(std::uint64_t i) noexcept { return std::uint64_t{1} << i; }

std::uint64_t PrimeClsPo2(std::uint64_t i) noexcept { return PRIMES[i]; }

// Newton's method from a power of two near the root.
std::uint64_t sqrtInt(std::uint64_t n) noexcept {
    constexpr std::uint64_t SMALL_ROOTS[] = {0, 1, 1, 1, 2};
    if (n < 5) return SMALL_ROOTS[n];
    // kept hash-02: tables are sized in 32 bits.
    std::int32_t const m = static_cast<std::int32_t>(static_cast<std::uint32_t>(n));
    if (m <= 0) return 0;
    int halvings = 0;
    for (std::int32_t rest = m; rest > 4; rest /= 2) ++halvings;
    std::int32_t x = std::int32_t{1} << ((halvings + 1) / 2);
    std::int32_t y = m / x;
    while (y - x >= 2 || x - y >= 2) {
        x = (x + y) / 2;
        y = m / x;
    }
    return static_cast<std::uint64_t>(x < y ? x : y);
}

} // namespace ZOR_Basis
