/// \file
/// Holds the text of a line against the one of `snprintf`.

#ifndef TESTS_LOG_LINE_CHECK_H
#define TESTS_LOG_LINE_CHECK_H

#include "basis/log/line_text.h"

#include <array>
#include <cstdarg>
#include <cstddef>
#include <cstdio>
#include <string>

inline constexpr std::size_t ROOM = 1023;

using Line = std::array<char, ROOM>;

inline std::string whole(Line const& line, std::size_t room) { return {line.data(), room}; }

/// Both ways write into lines of X, so that all bytes can be compared that count.
struct Written {
    std::string ours;
    bool quickly = false;
};

inline Written writtenWith(std::size_t room, char const* format, ...) {
    Line line;
    line.fill('X');
    std::va_list arguments;
    va_start(arguments, format);
    Written written;
    written.quickly = ZOR_Basis::writeLineTextQuickly(line.data(), room, format, arguments);
    line.fill('X');
    ZOR_Basis::writeLineText(line.data(), room, format, arguments);
    va_end(arguments);
    written.ours = line.data();
    return written;
}

template <class... Values>
std::string printed(std::size_t room, char const* format, Values... values) {
    Line line;
    line.fill('Y');
    std::snprintf(line.data(), room, format, values...);
    return line.data();
}

#endif
