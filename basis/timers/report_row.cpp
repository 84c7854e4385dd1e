#include "basis/timers/report_row.h"

#include "zor_basis/timers/thousands_separator.h"

#include <algorithm>
#include <cstring>

namespace ZOR_Basis::ReportRow {
namespace {

/// Where the columns end: two places behind their last digits.
enum End : std::uint64_t {
    COUNT = 50,
    TOTAL = 65,
    AVERAGE = 80,
    MAXIMUM = 95,
    MAXIMUM_COUNT = 110,
    MINIMUM = 125,
    SUSPEND_TOTAL = 140,
    SUSPEND_MAXIMUM = 155,
};

constexpr int GROUP = 3;

std::uint64_t magnitude(std::int64_t value) {
    auto const bits = static_cast<std::uint64_t>(value);
    return value < 0 ? 0 - bits : bits;
}

} // namespace

std::int64_t convert(std::int64_t ticks, int unitsPerSecond, std::int64_t frequency) {
    std::int64_t const units = unitsPerSecond;
    auto const whole = static_cast<std::uint64_t>(ticks / frequency) * static_cast<std::uint64_t>(units);
    auto const rest = static_cast<std::uint64_t>(ticks % frequency * units / frequency);
    return static_cast<std::int64_t>(whole + rest);
}

void placeNumber(char* line, std::int64_t value, std::uint64_t end, char separator, bool terminating) {
    // kept timers-06: readers of the file find the end of a row's numbers by this byte.
    if (terminating) line[end - 1] = '\0';
    std::uint64_t rest = magnitude(value);
    std::uint64_t place = end - 2;
    int inGroup = 0;
    while (place > 0) {
        line[place--] = "0123456789"[rest % 10];
        rest /= 10;
        if (rest == 0) break;
        if (++inGroup == GROUP && separator != '\0' && place > 0) {
            line[place--] = separator;
            inGroup = 0;
        }
    }
    if (value < 0) line[place] = '-';
}

void format(BufStr<255>& line, Str const& name, Values const& values) {
    line.clear();
    line.extendBuf(SIZE);
    char* const row = line.getBuf();
    std::memset(row, ' ', SIZE);
    line.resize(SIZE);
    // kept timers-07: the name comes first and is not cut at its column.
    std::memcpy(row, name.c_str(), std::min(name.size(), SIZE));
    char const separator = thousandsSeparator();
    placeNumber(row, values.count, COUNT, separator, CONTINUING);
    if (values.count == 0) return;
    placeNumber(row, values.total, TOTAL, separator, CONTINUING);
    placeNumber(row, values.average, AVERAGE, separator, CONTINUING);
    placeNumber(row, values.maximum, MAXIMUM, separator, CONTINUING);
    placeNumber(row, values.maximumCount, MAXIMUM_COUNT, separator, CONTINUING);
    placeNumber(row, values.minimum, MINIMUM, separator, CONTINUING);
    placeNumber(row, values.suspendTotal, SUSPEND_TOTAL, separator, CONTINUING);
    placeNumber(row, values.suspendMaximum, SUSPEND_MAXIMUM, separator, TERMINATING);
}

} // namespace ZOR_Basis::ReportRow
