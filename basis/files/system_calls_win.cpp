// The sibling is system_calls_posix.cpp.

#include "basis/files/system_calls.h"

#include "basis/files/last_error.h"
#include "basis/platform/windows_api_win.h"

#include <direct.h>
#include <sys/stat.h>
#include <sys/types.h>

namespace ZOR_Basis {
namespace {

constexpr std::size_t LONGEST_MODE = 15;

void copyRecord(struct __stat64 const& from, xos_Stat& record) {
    record.st_dev_ = from.st_dev;
    record.st_ino_ = from.st_ino;
    record.st_mode_ = from.st_mode;
    record.st_nlink_ = from.st_nlink;
    record.st_uid_ = from.st_uid;
    record.st_gid_ = from.st_gid;
    record.st_rdev_ = from.st_rdev;
    record.st_size_ = from.st_size;
    record.st_atime_ = from.st_atime;
    record.st_mtime_ = from.st_mtime;
    record.st_ctime_ = from.st_ctime;
}

/// Returns the result of a call of the runtime. \param call  returns true or a pointer if it succeeds
template <class Call>
auto told(Call call) {
    RuntimeCall const runtime;
    auto const result = call();
    if (!result) runtime.fail();
    return result;
}

bool status(char const* path, xos_Stat& record) {
    struct __stat64 found;
    if (!told([&] { return _stat64(path, &found) == 0; })) return false;
    copyRecord(found, record);
    return true;
}

bool statusWide(wchar_t const* path, xos_Stat& record) {
    struct __stat64 found;
    if (!told([&] { return _wstat64(path, &found) == 0; })) return false;
    copyRecord(found, record);
    return true;
}

bool makeDirectoryWide(wchar_t const* path) {
    return told([=] { return _wmkdir(path) == 0; });
}

std::FILE* openStream(char const* path, char const* mode) {
    return told([=] { return std::fopen(path, mode); });
}

std::FILE* openStreamWide(wchar_t const* path, char const* mode) {
    wchar_t wideMode[LONGEST_MODE + 1] = {};
    for (std::size_t i = 0; i < LONGEST_MODE && mode[i] != '\0'; ++i) wideMode[i] = static_cast<unsigned char>(mode[i]);
    return told([&] { return _wfopen(path, wideMode); });
}

std::uint32_t lastError() { return GetLastError(); }

void sleepMs(std::uint32_t ms) { Sleep(ms); }

std::uint64_t tick() { return GetTickCount64(); }

} // namespace

SystemCalls systemCalls{status,    status,  statusWide, makeDirectoryWide, openStream, openStreamWide,
                        lastError, sleepMs, tick};

} // namespace ZOR_Basis
