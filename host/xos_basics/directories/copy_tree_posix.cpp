// Used by tree_posix.cpp; its counterpart for Windows works with paths.

#include "host/xos_basics/directories/copy_tree_posix.h"

#include "host/xos_basics/directories/directory_chain_posix.h"
#include "host/xos_basics/directories/dirents_posix.h"
#include "host/xos_basics/directories/name_queue.h"
#include "host/xos_basics/result.h"

#include <climits>
#include <sys/sysmacros.h>
#include <unistd.h>
#include <vector>

namespace host {

namespace {

/// Whether a new entry may take this name.
/// \param source  what it is made of
bool mayTakeName(int at, char const* name, struct stat const& source, bool overwrite) {
    struct stat present {};
    if (::fstatat(at, name, &present, AT_SYMLINK_NOFOLLOW) != 0) return errno == ENOENT;
    if (!overwrite) return failWith(EEXIST);
    return isReplaceable(present) && (!sameEntry(present, source) || failWith(EINVAL));
}

bool makeLink(int fromAt, char const* from, struct stat const& status, int toAt, char const* to) {
    char target[PATH_MAX];
    ssize_t const length = ::readlinkat(fromAt, from, target, sizeof target - 1);
    if (length < 0) return false;
    target[length] = '\0';
    if (::symlinkat(target, toAt, to) != 0) return false;
    struct timespec const times[2] = {{0, UTIME_OMIT}, status.st_mtim};
    ::utimensat(toAt, to, times, AT_SYMLINK_NOFOLLOW);
    return true;
}

bool makeSpecial(int fromAt, char const* from, struct stat const& status, int toAt, char const* to) {
    if (S_ISLNK(status.st_mode)) return makeLink(fromAt, from, status, toAt, to);
    return ::mknodat(toAt, to, status.st_mode & (S_IFMT | 0777), status.st_rdev) == 0;
}

class TreeCopy {
public:
    explicit TreeCopy(CopyRules rules) : rules_(rules) {}

    bool run(Descriptor from, struct stat const& fromStatus, Descriptor to);

private:
    /// One directory of both chains, with those of its directories that are still to be copied.
    struct Level {
        NameQueue directories;
        struct stat source;
        bool isNew;
    };

    bool push(Descriptor from, struct stat const& status, Descriptor to, bool isNew);
    bool copyEntries();
    bool copyEntry(char const* name, mode_t type);
    bool copyFile(char const* name);
    bool enter(char const* name);
    bool leave();

    CopyRules rules_;
    DirectoryChain from_;
    DirectoryChain to_;
    std::vector<Level> levels_;
    Dirents dirents_;
    FileCopier copier_;
};

bool TreeCopy::run(Descriptor from, struct stat const& fromStatus, Descriptor to) {
    if (!push(std::move(from), fromStatus, std::move(to), rules_.unseen)) return false;
    while (!levels_.empty()) {
        NameQueue& waiting = levels_.back().directories;
        if (waiting.empty()) {
            if (!leave()) return false;
        } else if (!enter(waiting.first())) {
            return false;
        }
    }
    return true;
}

bool TreeCopy::push(Descriptor from, struct stat const& status, Descriptor to, bool isNew) {
    if (!from_.push(std::move(from)) || !to_.push(std::move(to))) return false;
    levels_.push_back({{}, status, isNew});
    return copyEntries();
}

bool TreeCopy::copyEntries() {
    int const directory = from_.lowest();
    while (dirents_.next(directory)) {
        mode_t const type = dirents_.type(directory);
        if (S_ISDIR(type)) {
            if (rules_.recursive) levels_.back().directories.add(dirents_.name());
        } else if (!copyEntry(dirents_.name(), type)) {
            return false;
        }
    }
    return !dirents_.failed();
}

bool TreeCopy::copyEntry(char const* name, mode_t type) {
    if (S_ISREG(type)) return copyFile(name);
    struct stat status {};
    return ::fstatat(from_.lowest(), name, &status, AT_SYMLINK_NOFOLLOW) == 0 &&
           copySpecial(from_.lowest(), name, status, to_.lowest(), name, rules_);
}

bool TreeCopy::copyFile(char const* name) {
    struct stat status {};
    Descriptor const source = openSource(from_.lowest(), name, O_NOFOLLOW, status);
    if (!source) return false;
    if (rules_.unseen) return copier_.copyToNew(source.get(), status, to_.lowest(), name);
    return mayTakeName(to_.lowest(), name, status, rules_.overwrite) &&
           copier_.copyTo(source.get(), status, to_.lowest(), name, rules_.overwrite);
}

bool TreeCopy::enter(char const* name) {
    Descriptor from{::openat(from_.lowest(), name, O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC)};
    struct stat status {};
    if (!from || ::fstat(from.get(), &status) != 0) return false;
    bool const isNew = ::mkdirat(to_.lowest(), name, 0700) == 0;
    if (!isNew && (errno != EEXIST || rules_.unseen)) return false;
    Descriptor to{::openat(to_.lowest(), name, O_PATH | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC)};
    return to && push(std::move(from), status, std::move(to), isNew);
}

bool TreeCopy::leave() {
    // The way up comes first: the copy's permissions may close it.
    if (!from_.findAbove() || !to_.findAbove()) return false;
    Level const& level = levels_.back();
    if (level.isNew) {
        struct timespec const times[2] = {{0, UTIME_OMIT}, level.source.st_mtim};
        ::utimensat(to_.lowest(), ".", times, 0);
        if (::fchmodat(to_.lowest(), ".", permissionsOfCopy(level.source), 0) != 0 && errno != EPERM) return false;
    }
    from_.pop();
    to_.pop();
    levels_.pop_back();
    if (!levels_.empty()) levels_.back().directories.dropFirst();
    return true;
}

} // namespace

bool copyTree(Descriptor from, struct stat const& fromStatus, Descriptor to, CopyRules rules) {
    // Told as any other failure, so that the caller can clear away what is there already.
    return unlessMemoryLacks(
        false, [&] { return std::make_unique<TreeCopy>(rules)->run(std::move(from), fromStatus, std::move(to)); });
}

bool copySpecial(int fromAt, char const* from, struct stat const& status, int toAt, char const* to, CopyRules rules) {
    if (rules.unseen) return makeSpecial(fromAt, from, status, toAt, to);
    if (!mayTakeName(toAt, to, status, rules.overwrite)) return false;
    std::string const temporary =
        makeTemporary([&](char const* name) { return makeSpecial(fromAt, from, status, toAt, name); });
    return !temporary.empty() && putInPlace(toAt, temporary, to, rules.overwrite);
}

} // namespace host
