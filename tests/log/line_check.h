/// \file
/// Compares the text of a line with that of `snprintf`.

#ifndef TESTS_LOG_LINE_CHECK_H
#define TESTS_LOG_LINE_CHECK_H

#include "basis/log/line_text.h"

#include <gtest/gtest.h>

#include <array>
#include <cstdarg>
#include <cstddef>
#include <cstdio>
#include <string>

inline constexpr std::size_t ROOM = 1023;

using Line = std::array<char, ROOM>;

struct Written {
    std::string ours;
    bool quickly = false;
};

inline Written writtenWith(std::size_t room, char const* format, ...) {
    Line line;
    line.fill('X');
    ZOR_Basis::LineArguments arguments;
    va_start(arguments.list, format);
    Written written;
    char const* end = ZOR_Basis::writeLineText(line.data(), room, format, arguments);
    written.quickly = end != nullptr;
    va_end(arguments.list);
    if (!written.quickly) {
        line.fill('X');
        va_start(arguments.list, format);
        end = ZOR_Basis::writeAnyLineText(line.data(), room, format, arguments);
        va_end(arguments.list);
    }
    written.ours = line.data();
    EXPECT_EQ(end, line.data() + written.ours.size());
    return written;
}

template <class... Values>
std::string printed(std::size_t room, char const* format, Values... values) {
    Line line;
    line.fill('Y');
    // The last argument is never used; without arguments, compilers warn about the format.
    std::snprintf(line.data(), room, format, values..., nullptr);
    return line.data();
}

/// Compares with `snprintf`. \return whether the short way was taken
template <class... Values>
bool check(char const* format, Values... values) {
    Written const written = writtenWith(ROOM, format, values...);
    EXPECT_EQ(written.ours, printed(ROOM, format, values...)) << format;
    return written.quickly;
}

#endif
