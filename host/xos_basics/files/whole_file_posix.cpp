// The sibling is whole_file_win.cpp.

#include "host/xos_basics/files/whole_file.h"

#include "host/xos_basics/files/entry_posix.h"
#include "host/xos_basics/files/file_copy_posix.h"

#include <algorithm>
#include <cstdio>
#include <fcntl.h>
#include <limits>
#include <unistd.h>

namespace host {

namespace {

/// A number as far as the record's field can hold it.
template <class Field, class Number>
Field clamped(Number number) {
    constexpr auto MOST = std::numeric_limits<Field>::max();
    return number > static_cast<Number>(MOST) ? MOST : static_cast<Field>(number);
}

bool endsInSlash(std::string const& path) { return !path.empty() && path.back() == '/'; }

/// Whether both paths lead to one entry, as opposed to two names of one file.
bool isOneName(char const* a, char const* b) {
    Place placeA;
    Place placeB;
    struct stat directoryA {};
    struct stat directoryB {};
    return findPlace(a, placeA) && findPlace(b, placeB) && placeA.name == placeB.name &&
           ::fstat(placeA.at(), &directoryA) == 0 && ::fstat(placeB.at(), &directoryB) == 0 &&
           sameEntry(directoryA, directoryB);
}

} // namespace

bool removeFile(char const* path) { return ::unlink(systemPath(path).c_str()) == 0; }

bool copyFile(char const* dst, char const* src, bool overwrite) {
    struct stat source {};
    Descriptor const from = openSource(AT_FDCWD, systemPath(src).c_str(), 0, source);
    if (!from) return false;
    Place to;
    if (endsInSlash(systemPath(dst))) return failWith(EISDIR);
    if (!findPlace(dst, to)) return false;
    struct stat present {};
    if (::fstatat(to.at(), to.name.c_str(), &present, AT_SYMLINK_NOFOLLOW) == 0) {
        if (!overwrite) return failWith(EEXIST);
        if (!isReplaceable(present)) return false;
        if (sameEntry(source, present)) return failWith(EINVAL);
    } else if (errno != ENOENT) {
        return false;
    }
    return FileCopier{}.copyTo(from.get(), source, to.at(), to.name.c_str(), overwrite);
}

bool moveFile(char const* dst, char const* src, bool overwrite) {
    std::string const from = systemPath(src);
    std::string const to = systemPath(dst);
    struct stat source {};
    if (::lstat(from.c_str(), &source) != 0) return false;
    if (S_ISDIR(source.st_mode)) return failWith(EISDIR);
    if (renameToNew(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str())) return true;
    if (errno != EEXIST || !overwrite) return false;
    struct stat present {};
    if (::lstat(to.c_str(), &present) != 0 || !isReplaceable(present)) return false;
    if (sameEntry(source, present)) {
        // Renaming one name of a file onto another leaves both.
        return isOneName(dst, src) || ::unlink(from.c_str()) == 0;
    }
    return ::rename(from.c_str(), to.c_str()) == 0;
}

bool linkFile(char const* src, char const* dst) {
    return ::linkat(AT_FDCWD, systemPath(src).c_str(), AT_FDCWD, systemPath(dst).c_str(), 0) == 0;
}

bool statusOf(char const* path, xos_Stat& record) {
    struct stat status {};
    if (::lstat(entryPath(path).c_str(), &status) != 0) return false;
    record = {};
    record.st_dev_ = static_cast<std::uint32_t>(status.st_dev);
    record.st_ino_ = static_cast<std::uint16_t>(status.st_ino);
    // The kinds have the same bits on both systems.
    record.st_mode_ = static_cast<std::uint16_t>(status.st_mode);
    record.st_nlink_ = clamped<std::int16_t>(status.st_nlink);
    record.st_uid_ = clamped<std::int16_t>(status.st_uid);
    record.st_gid_ = clamped<std::int16_t>(status.st_gid);
    record.st_rdev_ = static_cast<std::uint32_t>(status.st_rdev);
    record.st_size_ = status.st_size;
    record.st_atime_ = status.st_atime;
    record.st_mtime_ = status.st_mtime;
    record.st_ctime_ = status.st_ctime;
    return true;
}

} // namespace host
