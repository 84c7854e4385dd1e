// The sibling is age_posix.cpp. The standard library cannot set the time of a directory here.

#include "tests/host/support/status.h"

#include "host/windows_api.h"

void setAge(std::string const& path, std::chrono::hours age) {
    HANDLE const entry = CreateFileA(path.c_str(), FILE_WRITE_ATTRIBUTES, FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr,
                                     OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS, nullptr);
    FILETIME now{};
    GetSystemTimeAsFileTime(&now);
    constexpr ULONGLONG PER_HOUR = 36'000'000'000;
    ULARGE_INTEGER time{};
    time.LowPart = now.dwLowDateTime;
    time.HighPart = now.dwHighDateTime;
    time.QuadPart -= static_cast<ULONGLONG>(age.count()) * PER_HOUR;
    FILETIME const then{time.LowPart, time.HighPart};
    SetFileTime(entry, nullptr, nullptr, &then);
    CloseHandle(entry);
}
