/// \file
/// Integers in decimal digits.

#ifndef BASIS_LOG_DECIMAL_DIGITS_H
#define BASIS_LOG_DECIMAL_DIGITS_H

#include <bit>
#include <cstdint>
#include <cstring>

namespace ZOR_Basis {

inline constexpr std::uint64_t POWERS_OF_TEN[] = {
    1ull,
    10ull,
    100ull,
    1'000ull,
    10'000ull,
    100'000ull,
    1'000'000ull,
    10'000'000ull,
    100'000'000ull,
    1'000'000'000ull,
    10'000'000'000ull,
    100'000'000'000ull,
    1'000'000'000'000ull,
    10'000'000'000'000ull,
    100'000'000'000'000ull,
    1'000'000'000'000'000ull,
    10'000'000'000'000'000ull,
    100'000'000'000'000'000ull,
    1'000'000'000'000'000'000ull,
    10'000'000'000'000'000'000ull,
};

/// 1 for 0.
inline int decimalDigits(std::uint64_t number) {
    // A bit is worth 1233 / 4096 digits, which is exact enough up to 64 of them.
    int const digits = static_cast<int>(std::bit_width(number | 1)) * 1233 >> 12;
    return digits + (number >= POWERS_OF_TEN[digits] || digits == 0 ? 1 : 0);
}

/// Writes exactly so many digits, the last ones of the number.
/// \return their end
inline char* writeDigits(char* to, std::uint64_t number, int digits) {
    static constexpr char PAIRS[] = "0001020304050607080910111213141516171819202122232425262728293031323334353637383940"
                                    "4142434445464748495051525354555657585960616263646566676869707172737475767778798081"
                                    "828384858687888990919293949596979899";
    char* const end = to + digits;
    char* at = end;
    for (; at - to >= 2; number /= 100) {
        at -= 2;
        std::memcpy(at, PAIRS + number % 100 * 2, 2);
    }
    if (at != to) *to = static_cast<char>('0' + number % 10);
    return end;
}

inline char* writeDecimal(char* to, std::uint64_t number) { return writeDigits(to, number, decimalDigits(number)); }

} // namespace ZOR_Basis

#endif
