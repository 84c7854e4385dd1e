/// \file
/// The layout of one timer's row in a report.

#ifndef BASIS_TIMERS_REPORT_ROW_H
#define BASIS_TIMERS_REPORT_ROW_H

#include "zor_basis/text/buf_str.h"

#include <cstdint>

namespace ZOR_Basis::ReportRow {

inline constexpr std::uint64_t SIZE = 156;

/// Durations are converted already. With a count of 0 the others are not shown.
struct Values {
    std::int64_t count = 0, total = 0, average = 0, maximum = 0, maximumCount = 0, minimum = 0;
    std::int64_t suspendTotal = 0, suspendMaximum = 0;
};

/// Converts ticks to another unit, rounding towards zero. Only a result beyond 64 bits overflows; it wraps.
std::int64_t convert(std::int64_t ticks, int unitsPerSecond, std::int64_t frequency);

/// Names for `terminating`.
inline constexpr bool TERMINATING = true;
inline constexpr bool CONTINUING = false;

/// Writes a number from the right: its last digit two places before `end`. The first place of the line is never
/// reached.
/// \param separator  between groups of three digits; 0: none
/// \param terminating  stores a zero byte one place before `end`
void placeNumber(char* line, std::int64_t value, std::uint64_t end, char separator, bool terminating);

/// Makes the line the row of a timer.
void format(BufStr<255>& line, Str const& name, Values const& values);

} // namespace ZOR_Basis::ReportRow

#endif
