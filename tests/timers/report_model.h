/// \file
/// A plain model of a report row.

#ifndef TESTS_TIMERS_REPORT_MODEL_H
#define TESTS_TIMERS_REPORT_MODEL_H

#include <zor_basis/text/buf_str.h>

#include <cstdint>
#include <string>

/// A number as text with its groups of three digits separated.
inline std::string grouped(std::int64_t value, char separator) {
    std::string text = std::to_string(value);
    std::size_t const first = value < 0 ? 1 : 0;
    if (separator != '\0') {
        for (std::size_t i = text.size(); i > first + 3;) text.insert(i -= 3, 1, separator);
    }
    return text;
}

/// The numbers of a row from left to right, in its unit.
struct RowNumbers {
    std::int64_t count = 0;
    std::int64_t total = 0;
    std::int64_t average = 0;
    std::int64_t max = 0;
    std::int64_t maxCount = 0;
    std::int64_t min = 0;
    std::int64_t suspendTotal = 0;
    std::int64_t suspendMax = 0;
};

/// The numbers of a row about one measurement.
inline RowNumbers measuredOnce(std::int64_t elapsed) {
    return {.count = 1, .total = elapsed, .average = elapsed, .max = elapsed, .maxCount = 1, .min = elapsed};
}

inline std::string modelRow(std::string const& name, RowNumbers const& shown, char separator) {
    struct Column {
        std::size_t last;
        std::int64_t number;
    };
    Column const columns[] = {{48, shown.count},         {63, shown.total},      {78, shown.average},
                              {93, shown.max},           {108, shown.maxCount},  {123, shown.min},
                              {138, shown.suspendTotal}, {153, shown.suspendMax}};
    std::string row = name.substr(0, 156);
    row.resize(156, ' ');
    for (Column const& column : columns) {
        std::string const text = grouped(column.number, separator);
        row.replace(column.last + 1 - text.size(), text.size(), text);
        if (shown.count == 0) return row;
    }
    row[154] = '\0';
    return row;
}

inline std::string bytesOfRow(ZOR_Basis::BufStr<255> const& line) { return {line.c_str(), line.size()}; }

#endif
