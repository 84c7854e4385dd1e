// The sibling is entry_win.cpp.

#include "host/xos_basics/files/entry_posix.h"

#include <atomic>
#include <cstdio>
#include <ctime>
#include <fcntl.h>
#include <unistd.h>

namespace host {

bool findPlace(char const* path, Place& place) {
    std::string const text = entryPath(path);
    if (text.empty()) return failWith(ENOENT);
    std::size_t const slash = text.rfind('/');
    std::string const directory = slash == std::string::npos ? "." : text.substr(0, slash + 1);
    place.name = slash == std::string::npos ? text : text.substr(slash + 1);
    if (place.name.empty()) place.name.push_back('.');
    place.directory = Descriptor{::open(directory.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)};
    return static_cast<bool>(place.directory);
}

std::string temporaryName() {
    static std::atomic<unsigned> counter{0};
    struct timespec now {};
    ::clock_gettime(CLOCK_REALTIME, &now);
    char name[64];
    std::snprintf(name, sizeof name, ".xos-%x-%x-%lx.tmp", static_cast<unsigned>(::getpid()),
                  counter.fetch_add(1, std::memory_order_relaxed), static_cast<unsigned long>(now.tv_nsec));
    return name;
}

namespace {

bool isDirectory(int at, char const* name) {
    struct stat status {};
    return ::fstatat(at, name, &status, AT_SYMLINK_NOFOLLOW) == 0 && S_ISDIR(status.st_mode);
}

/// For file systems whose rename cannot be told to spare the target: takes the new name first, which succeeds only for
/// one, then renames onto what it made.
bool renameOntoOwnPlaceholder(int fromAt, char const* from, int toAt, char const* to) {
    if (isDirectory(fromAt, from)) {
        if (::mkdirat(toAt, to, 0700) != 0) return false;
        if (::renameat(fromAt, from, toAt, to) == 0) return true;
        KeepErrno const keep;
        ::unlinkat(toAt, to, AT_REMOVEDIR);
        return false;
    }
    if (::linkat(fromAt, from, toAt, to, 0) == 0) {
        if (::unlinkat(fromAt, from, 0) == 0) return true;
        KeepErrno const keep;
        ::unlinkat(toAt, to, 0);
        return false;
    }
    if (errno != EPERM && errno != EOPNOTSUPP && errno != ENOSYS && errno != EMLINK) return false;
    Descriptor const placeholder{::openat(toAt, to, O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0600)};
    if (!placeholder) return false;
    if (::renameat(fromAt, from, toAt, to) == 0) return true;
    KeepErrno const keep;
    ::unlinkat(toAt, to, 0);
    return false;
}

} // namespace

bool renameToNew(int fromAt, char const* from, int toAt, char const* to) {
    if (::renameat2(fromAt, from, toAt, to, RENAME_NOREPLACE) == 0) return true;
    if (errno != EINVAL && errno != ENOSYS) return false;
    return renameOntoOwnPlaceholder(fromAt, from, toAt, to);
}

bool putInPlace(int at, std::string const& temporary, char const* name, bool overwrite) {
    bool const done =
        overwrite ? ::renameat(at, temporary.c_str(), at, name) == 0 : renameToNew(at, temporary.c_str(), at, name);
    if (done) return true;
    KeepErrno const keep;
    ::unlinkat(at, temporary.c_str(), 0);
    return false;
}

bool isReplaceable(struct stat const& status) {
    if (S_ISDIR(status.st_mode)) return failWith(EISDIR);
    return S_ISREG(status.st_mode) || S_ISLNK(status.st_mode) || failWith(EEXIST);
}

} // namespace host
