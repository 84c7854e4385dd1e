#include "basis/log/fixed_decimal.h"

#include "basis/log/decimal_digits.h"

#include <bit>

namespace ZOR_Basis {
namespace {

constexpr int FRACTION_BITS = 52;
constexpr std::uint64_t FRACTION = (std::uint64_t{1} << FRACTION_BITS) - 1;
constexpr int EXPONENTS = 0x7FF;
/// Of a number whose 53 bits are taken as an integer.
constexpr int EXPONENT_BIAS = 1023 + FRACTION_BITS;
constexpr int WORD = 64;
constexpr int MOST_WHOLE_BITS = 63;

/// 128 bits.
struct Wide {
    std::uint64_t high;
    std::uint64_t low;
};

Wide product(std::uint64_t a, std::uint64_t b) {
    constexpr int HALF = 32;
    constexpr std::uint64_t LOW = 0xFFFF'FFFF;
    std::uint64_t const low = (a & LOW) * (b & LOW);
    std::uint64_t const crossed = (a >> HALF) * (b & LOW) + (low >> HALF);
    std::uint64_t const rest = (a & LOW) * (b >> HALF) + (crossed & LOW);
    return {(a >> HALF) * (b >> HALF) + (crossed >> HALF) + (rest >> HALF), rest << HALF | (low & LOW)};
}

std::uint64_t lowBits(std::uint64_t word, int bits) { return word & ((std::uint64_t{1} << bits) - 1); }

/// value / 2^bits, for bits from 1 to 127, and how what is left compares with a half: below, equal or above 0.
struct Shifted {
    std::uint64_t whole;
    int restToHalf;
};

int compare(std::uint64_t a, std::uint64_t b) { return a < b ? -1 : a > b ? 1 : 0; }

Shifted shift(Wide value, int bits) {
    if (bits < WORD) {
        return {value.high << (WORD - bits) | value.low >> bits,
                compare(lowBits(value.low, bits), std::uint64_t{1} << (bits - 1))};
    }
    if (bits == WORD) return {value.high, compare(value.low, std::uint64_t{1} << (WORD - 1))};
    int const highBits = bits - WORD;
    int const high = compare(lowBits(value.high, highBits), std::uint64_t{1} << (highBits - 1));
    return {value.high >> highBits, high != 0 || value.low == 0 ? high : 1};
}

} // namespace

bool takeApart(double number, int decimals, FixedDecimal& out) {
    auto const bits = std::bit_cast<std::uint64_t>(number);
    int const exponent = static_cast<int>(bits >> FRACTION_BITS) & EXPONENTS;
    bool const isSubnormal = exponent == 0;
    std::uint64_t const digits = (bits & FRACTION) | (isSubnormal ? 0 : FRACTION + 1);
    // The number is digits / 2^below.
    int const below = EXPONENT_BIAS - (isSubnormal ? 1 : exponent);
    if (FRACTION_BITS + 1 - below > MOST_WHOLE_BITS) return false;
    if (below <= 0) {
        out = {digits << -below, 0};
        return true;
    }
    std::uint64_t const whole = below < WORD ? digits >> below : 0;
    std::uint64_t const fraction = below < WORD ? lowBits(digits, below) : digits;
    std::uint64_t const scale = POWERS_OF_TEN[decimals];
    // From 2^128 on not even a half is left of 53 bits times the largest scale.
    Shifted const scaled = below < 2 * WORD ? shift(product(fraction, scale), below) : Shifted{0, -1};
    bool const isOdd = ((decimals == 0 ? whole : scaled.whole) & 1) != 0;
    bool const isUp = scaled.restToHalf > 0 || (scaled.restToHalf == 0 && isOdd);
    std::uint64_t const rounded = scaled.whole + (isUp ? 1 : 0);
    out = rounded == scale ? FixedDecimal{whole + 1, 0} : FixedDecimal{whole, rounded};
    return true;
}

} // namespace ZOR_Basis
