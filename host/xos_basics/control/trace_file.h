/// \file
/// Where the trace goes. Twins: trace_file_posix.cpp, trace_file_win.cpp.

#ifndef HOST_XOS_BASICS_CONTROL_TRACE_FILE_H
#define HOST_XOS_BASICS_CONTROL_TRACE_FILE_H

#include <cstdint>
#include <string_view>

namespace host {

/// An open file, which may be number 0.
using TraceFile = std::intptr_t;

constexpr TraceFile NO_TRACE_FILE = -1;

/// Opens a file for appending and makes it if it is missing, for this user alone. Children do not inherit it.
/// \param path  "-" is standard error
/// \return `NO_TRACE_FILE` on failure; the last error is then set
TraceFile openTrace(char const* path);

/// Appends a line in one piece, so that the lines of several threads and processes do not mix. What cannot be written
/// is lost.
void writeTrace(TraceFile file, std::string_view line);

std::uint64_t processNumber();

/// As debuggers show it.
std::uint64_t threadNumber();

} // namespace host

#endif
