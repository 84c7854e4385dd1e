/// \file
/// Compares the text of a line with that of `snprintf`.

#ifndef TESTS_LOG_LINE_CHECK_H
#define TESTS_LOG_LINE_CHECK_H

#include "basis/log/line_text.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <cstdarg>
#include <cstddef>
#include <cstdio>
#include <string>

inline constexpr std::size_t ROOM = 1023;

/// Bytes behind every room, which stay as they are.
inline constexpr std::size_t BEHIND = 80;

using Line = std::array<char, ROOM + BEHIND>;

struct Written {
    std::string ours;
    bool quickly = false;
};

inline bool isUntouchedBehind(std::size_t room, Line const& line) {
    return std::all_of(line.begin() + static_cast<std::ptrdiff_t>(room), line.end(), [](char c) { return c == 'X'; });
}

inline Written writtenWith(std::size_t room, char const* format, ...) {
    Line line;
    line.fill('X');
    ZOR_Basis::LineArguments arguments;
    va_start(arguments.list, format);
    Written written;
    char const* end = ZOR_Basis::writeLineText(line.data(), room, format, arguments);
    written.quickly = end != nullptr;
    EXPECT_TRUE(isUntouchedBehind(room, line)) << format << " in " << room;
    va_end(arguments.list);
    if (!written.quickly) {
        line.fill('X');
        va_start(arguments.list, format);
        end = ZOR_Basis::writeAnyLineText(line.data(), room, format, arguments);
        va_end(arguments.list);
        EXPECT_TRUE(isUntouchedBehind(room, line)) << format << " in " << room;
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
