// The sibling is trace_file_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/control/trace_file.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include <cstring>

namespace host {

static_assert(sizeof(HANDLE) == sizeof(TraceFile));

namespace {

constexpr DWORD FAR_BEHIND = 0x40000000;

constinit QuickMutex mutex;

/// One writer at a time, in all processes: not every system that runs Windows programs appends in one step. It locks a
/// byte behind every line; standard error cannot be locked if it is no file.
class Turn {
public:
    explicit Turn(HANDLE file) : file_(file) {
        mutex.lock();
        isLocked_ = LockFileEx(file_, LOCKFILE_EXCLUSIVE_LOCK, 0, 1, 0, &place_) != FALSE;
    }
    Turn(Turn const&) = delete;
    Turn& operator=(Turn const&) = delete;
    ~Turn() {
        if (isLocked_) UnlockFileEx(file_, 0, 1, 0, &place_);
        mutex.unlock();
    }

private:
    HANDLE file_;
    OVERLAPPED place_{0, 0, {{0, FAR_BEHIND}}, nullptr};
    bool isLocked_;
};

} // namespace

TraceFile openTrace(char const* path) {
    HANDLE const file = std::strcmp(path, "-") == 0 ? GetStdHandle(STD_ERROR_HANDLE)
                                                    : CreateFileA(path, FILE_APPEND_DATA | FILE_READ_DATA | SYNCHRONIZE,
                                                                  FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr,
                                                                  OPEN_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
    // A program without a console may have no standard error.
    return file == nullptr ? NO_TRACE_FILE : reinterpret_cast<TraceFile>(file);
}

void writeTrace(TraceFile file, std::string_view line) {
    auto* const handle = reinterpret_cast<HANDLE>(file);
    Turn const turn{handle};
    DWORD written = 0;
    WriteFile(handle, line.data(), static_cast<DWORD>(line.size()), &written, nullptr);
}

std::uint64_t processNumber() { return GetCurrentProcessId(); }

std::uint64_t threadNumber() { return GetCurrentThreadId(); }

} // namespace host
