/// \file
/// Timer reports as the library writes them, made without it.

#ifndef TESTS_ZBTOOL_SAMPLE_REPORTS_H
#define TESTS_ZBTOOL_SAMPLE_REPORTS_H

#include <cstdint>
#include <string>
#include <vector>

inline void placeDigits(std::string& row, std::int64_t number, std::size_t last, char separator) {
    std::string digits = std::to_string(number < 0 ? -number : number);
    if (separator != '\0') {
        for (std::size_t at = digits.size(); at > 3;) digits.insert(at -= 3, 1, separator);
    }
    if (number < 0) digits.insert(0, 1, '-');
    row.replace(last + 1 - digits.size(), digits.size(), digits);
}

/// \param numbers  are those of the columns from the count on; none: the timer never ran
inline std::string rowText(std::string const& name, std::vector<std::int64_t> const& numbers, char separator = ',') {
    std::string row(156, ' ');
    row.replace(0, name.size(), name);
    std::size_t const ends[] = {48, 63, 78, 93, 108, 123, 138, 153};
    if (numbers.empty()) placeDigits(row, 0, ends[0], separator);
    for (std::size_t i = 0; i < numbers.size(); ++i) placeDigits(row, numbers[i], ends[i], separator);
    if (!numbers.empty()) row[154] = '\0';
    return row + "\n";
}

inline std::string reportText(std::int64_t time, std::vector<std::string> const& rows) {
    std::string text = "Log timestamp (sec): " + std::to_string(time) + "\nTimers (mksec):\nFunction";
    text += "                                Count     Total          Average        Maximum        Maximum count  "
            "Minimum        Suspend total  Suspend Max    Notes                   \n";
    for (std::string const& row : rows) text += row;
    return text;
}

#endif
