/// \file
/// What the library asks of the system about entries, streams and time: system_calls_win.cpp, system_calls_posix.cpp.
/// Everything goes through one table, so that tests can make each call fail.

#ifndef BASIS_FILES_SYSTEM_CALLS_H
#define BASIS_FILES_SYSTEM_CALLS_H

#include "basis/platform/xos_basics.h"
#include "zor_basis/wide_char.h"

#include <cstdint>
#include <cstdio>

namespace ZOR_Basis {

/// Error codes of Windows, which stand for errors of the same kind on every system.
enum SystemError : std::uint32_t {
    NO_ERROR_YET = 0,
    FILE_NOT_FOUND = 2,
    PATH_NOT_FOUND = 3,
    ACCESS_DENIED = 5,
    NO_MORE_FILES = 18,
    GENERAL_FAILURE = 31,
    NETWORK_NAME_GONE = 64,
    LOGON_FAILURE = 1326,
};

struct SystemCalls {
    /// Status by a narrow path; on Linux of a link itself.
    /// \return whether there is an entry
    bool (*status)(char const* path, xos_Stat& record);
    /// The same for the target of a link.
    bool (*statusOfTarget)(char const* path, xos_Stat& record);
    /// Status by a wide path, following links.
    bool (*statusWide)(WChar const* path, xos_Stat& record);
    bool (*makeDirectoryWide)(WChar const* path);
    /// The streams of the runtime library; the mode is text that they understand.
    std::FILE* (*openStream)(char const* path, char const* mode);
    std::FILE* (*openStreamWide)(WChar const* path, char const* mode);
    /// The code of the calling thread's last error.
    std::uint32_t (*lastError)();
    void (*sleep)(std::uint32_t ms);
    /// Milliseconds since some start.
    std::uint64_t (*tick)();
};

/// Replaced by tests only, while nothing else runs.
extern SystemCalls systemCalls;

/// The file-type bits of a status record's mode, and their values.
inline constexpr std::uint32_t MODE_TYPE = 0xF000;
inline constexpr std::uint32_t MODE_FILE = 0x8000;
inline constexpr std::uint32_t MODE_DIRECTORY = 0x4000;
inline constexpr std::uint32_t MODE_LINK = 0xA000;

} // namespace ZOR_Basis

#endif
