/// \file
/// A report row, made the long way round.

#ifndef TESTS_TIMERS_REPORT_MODEL_H
#define TESTS_TIMERS_REPORT_MODEL_H

#include <array>
#include <cstdint>
#include <string>

/// A number with its groups of three digits, as text.
inline std::string grouped(std::int64_t value, char separator) {
    std::string text = std::to_string(value);
    std::size_t const first = value < 0 ? 1 : 0;
    if (separator != '\0') {
        for (std::size_t i = text.size(); i > first + 3;) text.insert(i -= 3, 1, separator);
    }
    return text;
}

/// \param shown  the eight numbers from count to suspend max, in the unit of the row
inline std::string modelRow(std::string const& name, std::array<std::int64_t, 8> const& shown, char separator) {
    constexpr std::array<std::size_t, 8> LAST{48, 63, 78, 93, 108, 123, 138, 153};
    std::string row = name.substr(0, 156);
    row.resize(156, ' ');
    for (std::size_t column = 0; column < (shown[0] != 0 ? LAST.size() : 1); ++column) {
        std::string const text = grouped(shown[column], separator);
        row.replace(LAST[column] + 1 - text.size(), text.size(), text);
    }
    if (shown[0] != 0) row[154] = '\0';
    return row;
}

#endif
