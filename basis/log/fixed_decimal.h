/// \file
/// The decimal digits of a number with a fixed count of them behind the point, rounded exactly.

#ifndef BASIS_LOG_FIXED_DECIMAL_H
#define BASIS_LOG_FIXED_DECIMAL_H

#include <cstdint>

namespace ZOR_Basis {

struct FixedDecimal {
    std::uint64_t whole;
    /// The digits behind the point, as a number.
    std::uint64_t decimals;
};

inline constexpr int MOST_DECIMALS = 19;

/// Splits the absolute value into digits. The exact value is rounded to the nearest decimal, a tie to the one with an
/// even last digit.
/// \param decimals  0 to `MOST_DECIMALS`
/// \return false, with `out` as it was, from 2^63 on and for what is no number
bool takeApart(double number, int decimals, FixedDecimal& out);

} // namespace ZOR_Basis

#endif
