// The sibling is system_calls_win.cpp.

#include "basis/files/system_calls.h"

#include "basis/files/os_path_posix.h"

#include <sys/stat.h>
#include <time.h>

#include <algorithm>
#include <cerrno>
#include <limits>

namespace ZOR_Basis {
namespace {

constexpr std::uint64_t MS_PER_SECOND = 1000;
constexpr std::uint64_t NS_PER_MS = 1'000'000;

/// A link count or id that does not fit is the largest one that does, rather than another file's or user's.
template <class From>
std::int16_t clamped(From value) {
    return static_cast<std::int16_t>(std::min<From>(value, std::numeric_limits<std::int16_t>::max()));
}

void copyRecord(struct stat const& from, xos_Stat& record) {
    record.st_dev_ = static_cast<std::uint32_t>(from.st_dev);
    record.st_ino_ = static_cast<std::uint16_t>(from.st_ino);
    record.st_mode_ = static_cast<std::uint16_t>(from.st_mode);
    record.st_nlink_ = clamped(from.st_nlink);
    record.st_uid_ = clamped(from.st_uid);
    record.st_gid_ = clamped(from.st_gid);
    record.st_rdev_ = static_cast<std::uint32_t>(from.st_rdev);
    record.st_size_ = from.st_size;
    record.st_atime_ = from.st_atim.tv_sec;
    record.st_mtime_ = from.st_mtim.tv_sec;
    record.st_ctime_ = from.st_ctim.tv_sec;
}

bool status(char const* path, xos_Stat& record) {
    struct stat found;
    if (lstat(OsPath(path), &found) != 0) return false;
    copyRecord(found, record);
    return true;
}

bool statusOfTarget(char const* path, xos_Stat& record) {
    struct stat found;
    if (stat(OsPath(path), &found) != 0) return false;
    copyRecord(found, record);
    return true;
}

bool statusWide(WChar const* path, xos_Stat& record) {
    struct stat found;
    if (stat(OsPath(path), &found) != 0) return false;
    copyRecord(found, record);
    return true;
}

bool makeDirectoryWide(WChar const* path) { return mkdir(OsPath(path), 0777) == 0; }

std::FILE* openStream(char const* path, char const* mode) { return std::fopen(OsPath(path), mode); }
std::FILE* openStreamWide(WChar const* path, char const* mode) { return std::fopen(OsPath(path), mode); }

std::uint32_t lastError() {
    switch (errno) {
    case 0:
        return NO_ERROR_YET;
    case ENOENT:
        return FILE_NOT_FOUND;
    case ENOTDIR:
        return PATH_NOT_FOUND;
    case EACCES:
        return ACCESS_DENIED;
    case ESTALE:
    case EHOSTDOWN:
    case EHOSTUNREACH:
    case ENETDOWN:
    case ENETUNREACH:
    case ENETRESET:
    case ENOLINK:
    case EREMOTEIO:
        return NETWORK_NAME_GONE;
    case EKEYREJECTED:
    case EKEYEXPIRED:
    case EKEYREVOKED:
    case ENOKEY:
        return LOGON_FAILURE;
    default:
        return GENERAL_FAILURE;
    }
}

void sleepMs(std::uint32_t ms) {
    timespec left{static_cast<time_t>(ms / MS_PER_SECOND), static_cast<long>(ms % MS_PER_SECOND * NS_PER_MS)};
    while (nanosleep(&left, &left) != 0 && errno == EINTR) {}
}

std::uint64_t tick() {
    timespec now{};
    clock_gettime(CLOCK_MONOTONIC, &now);
    return static_cast<std::uint64_t>(now.tv_sec) * MS_PER_SECOND + static_cast<std::uint64_t>(now.tv_nsec) / NS_PER_MS;
}

} // namespace

SystemCalls systemCalls{status,    statusOfTarget, statusWide, makeDirectoryWide, openStream, openStreamWide,
                        lastError, sleepMs,        tick};

} // namespace ZOR_Basis
