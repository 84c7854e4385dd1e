// The sibling is trace_file_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/control/trace_file.h"

#include <cstring>

namespace host {

static_assert(sizeof(HANDLE) == sizeof(TraceFile));

TraceFile openTrace(char const* path) {
    HANDLE const file = std::strcmp(path, "-") == 0
                            ? GetStdHandle(STD_ERROR_HANDLE)
                            : CreateFileA(path, FILE_APPEND_DATA | SYNCHRONIZE, FILE_SHARE_READ | FILE_SHARE_WRITE,
                                          nullptr, OPEN_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
    // A program without a console may have no standard error.
    return file == nullptr ? NO_TRACE_FILE : reinterpret_cast<TraceFile>(file);
}

void writeTrace(TraceFile file, std::string_view line) {
    DWORD written = 0;
    WriteFile(reinterpret_cast<HANDLE>(file), line.data(), static_cast<DWORD>(line.size()), &written, nullptr);
}

std::uint64_t processNumber() { return GetCurrentProcessId(); }

std::uint64_t threadNumber() { return GetCurrentThreadId(); }

} // namespace host
