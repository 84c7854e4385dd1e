// The sibling is tree_win.cpp.

#include "host/xos_basics/directories/tree.h"

#include "host/xos_basics/directories/copy_tree_posix.h"
#include "host/xos_basics/directories/remove_tree_posix.h"

#include <cstdio>
#include <fcntl.h>
#include <unistd.h>

namespace host {

namespace {

bool statusAt(Place const& place, struct stat& status) {
    return ::fstatat(place.at(), place.name.c_str(), &status, AT_SYMLINK_NOFOLLOW) == 0;
}

/// Finds an entry that can be removed: neither "." nor "..", nor the root.
bool findEntry(char const* path, Place& place, struct stat& status) {
    if (!findPlace(path, place)) return false;
    return isDots(place.name.c_str()) ? failWith(EINVAL) : statusAt(place, status);
}

/// Whether a directory is `other` or lies below it.
/// \return -1, with errno, when that cannot be found out
int isWithin(int directory, struct stat const& other) {
    Descriptor here{::openat(directory, ".", O_PATH | O_DIRECTORY | O_CLOEXEC)};
    struct stat status {};
    if (!here || ::fstat(here.get(), &status) != 0) return -1;
    for (;;) {
        if (sameEntry(status, other)) return 1;
        Descriptor above{::openat(here.get(), "..", O_PATH | O_DIRECTORY | O_CLOEXEC)};
        struct stat aboveStatus {};
        if (!above || ::fstat(above.get(), &aboveStatus) != 0) return -1;
        if (sameEntry(aboveStatus, status)) return 0;
        here = std::move(above);
        status = aboveStatus;
    }
}

/// False, with EINVAL, for a directory that is `other` or lies below it.
bool isOutside(int directory, struct stat const& other) {
    int const within = isWithin(directory, other);
    return within == 0 || (within == 1 && failWith(EINVAL));
}

bool copyToNewDirectory(Descriptor from, struct stat const& status, Place const& to, CopyRules rules) {
    std::string const temporary = makeTemporary([&](char const* name) { return ::mkdirat(to.at(), name, 0700) == 0; });
    if (temporary.empty()) return false;
    Descriptor target{::openat(to.at(), temporary.c_str(), O_PATH | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC)};
    rules.unseen = true;
    if (target && copyTree(std::move(from), status, std::move(target), rules) &&
        renameToNew(to.at(), temporary.c_str(), to.at(), to.name.c_str())) {
        return true;
    }
    KeepErrno const keep;
    removeTree(to.at(), temporary.c_str());
    return false;
}

} // namespace

bool createDirectory(char const* path) { return ::mkdir(systemPath(path).c_str(), 0777) == 0; }

bool removeDirectory(char const* path, bool recursive) {
    // An empty one, and never anything else, is gone by this alone.
    if (::rmdir(systemPath(path).c_str()) == 0) return true;
    Place place;
    struct stat status {};
    if (!findEntry(path, place, status)) return false;
    if (S_ISLNK(status.st_mode)) return ::unlinkat(place.at(), place.name.c_str(), 0) == 0;
    if (!S_ISDIR(status.st_mode)) return failWith(ENOTDIR);
    if (recursive) return removeTree(place.at(), place.name.c_str());
    return ::unlinkat(place.at(), place.name.c_str(), AT_REMOVEDIR) == 0;
}

bool copyDirectory(char const* dst, char const* src, bool overwrite, bool recursive) {
    CopyRules const rules{overwrite, recursive, false};
    Place from;
    Place to;
    struct stat source {};
    if (!findPlace(src, from) || !statusAt(from, source) || !findPlace(dst, to)) return false;
    if (S_ISREG(source.st_mode)) return failWith(ENOTDIR);
    if (!S_ISDIR(source.st_mode)) {
        return copySpecial(from.at(), from.name.c_str(), source, to.at(), to.name.c_str(), rules);
    }
    Descriptor directory{::openat(from.at(), from.name.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC)};
    if (!directory || ::fstat(directory.get(), &source) != 0) return false;
    Descriptor target{::openat(to.at(), to.name.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)};
    if (target) {
        return isOutside(target.get(), source) && copyTree(std::move(directory), source, std::move(target), rules);
    }
    struct stat present {};
    if (errno != ENOENT) return false;
    if (statusAt(to, present)) return failWith(EEXIST);
    return isOutside(to.at(), source) && copyToNewDirectory(std::move(directory), source, to, rules);
}

bool moveDirectory(char const* dst, char const* src, bool overwrite) {
    Place from;
    Place to;
    struct stat source {};
    struct stat present {};
    if (!findEntry(src, from, source) || !findPlace(dst, to)) return false;
    if (S_ISREG(source.st_mode)) return failWith(ENOTDIR);
    char const* const oldName = from.name.c_str();
    char const* const newName = to.name.c_str();
    if (renameToNew(from.at(), oldName, to.at(), newName)) return true;
    if ((errno != EEXIST && errno != ENOTEMPTY) || !overwrite || !findEntry(dst, to, present)) return false;
    if (!S_ISDIR(present.st_mode)) return failWith(ENOTDIR);
    if (sameEntry(source, present)) return true;
    // What lies in the target would go with it.
    if (!isOutside(from.at(), present)) return false;
    // Put aside, the target can come back when the move fails after all.
    std::string const aside =
        makeTemporary([&](char const* name) { return renameToNew(to.at(), newName, to.at(), name); });
    if (aside.empty()) return false;
    bool const moved = renameToNew(from.at(), oldName, to.at(), newName);
    if (moved && removeTree(to.at(), aside.c_str())) return true;
    KeepErrno const keep;
    if (moved) renameToNew(to.at(), newName, from.at(), oldName);
    renameToNew(to.at(), aside.c_str(), to.at(), newName);
    return false;
}

} // namespace host
