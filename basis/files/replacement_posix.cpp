// The sibling is replacement_win.cpp.

#include "basis/files/replacement_impl.h"

#include "basis/files/last_error.h"
#include "basis/files/os_path_posix.h"

#include <fcntl.h>
#include <limits.h>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

#include <cerrno>

namespace ZOR_Basis {
namespace {

/// The number of links that the system itself follows.
constexpr int MOST_LINKS = 40;
constexpr mode_t EVERYONE_READS_AND_WRITES = 0666;
constexpr mode_t ONLY_OWNER_READS_AND_WRITES = 0600;

bool failWith(int error) {
    errno = error;
    return false;
}

class Descriptor {
public:
    explicit Descriptor(int number) : number_(number) {}
    Descriptor(Descriptor const&) = delete;
    Descriptor& operator=(Descriptor const&) = delete;
    ~Descriptor() {
        KeepLastError const kept;
        if (number_ >= 0) ::close(number_);
    }
    int get() const { return number_; }
    bool isOpen() const { return number_ >= 0; }

private:
    int const number_;
};

/// Becomes the path that a link in the folder of `path` leads to.
void goTo(char const* link, std::uint64_t length, FPath& path) {
    if (*link == '/') path.clear();
    cutToFolder(path);
    BufStr<255>& text = path;
    text.add(link, length);
}

/// The permissions of a file whose group could not be kept: the new group gets those of all others.
mode_t withoutGroup(mode_t mode) { return (mode & 0707) | ((mode & 07) << 3 & mode); }

/// Gives the list of further users and groups, where there is one.
void keepAccessList(int from, int to) {
    static constexpr char LIST[] = "system.posix_acl_access";
    char list[4096];
    ssize_t const n = ::fgetxattr(from, LIST, list, sizeof list);
    if (n > 0) ::fsetxattr(to, LIST, list, static_cast<std::size_t>(n), 0);
}

/// If the file system stores none of this, or refuses it to this user, only the maker may use the file.
void keepAccess(int from, struct stat const& facts, int to) {
    mode_t const mode = facts.st_mode & 0777;
    if (::fchown(to, facts.st_uid, facts.st_gid) == 0) {
        ::fchmod(to, mode);
        keepAccessList(from, to);
    } else {
        bool const hasGroup = ::fchown(to, static_cast<uid_t>(-1), facts.st_gid) == 0;
        ::fchmod(to, hasGroup ? mode : withoutGroup(mode));
    }
}

} // namespace

bool followLinks(char const* path, FPath& target) {
    if (path == nullptr || *path == '\0') return failWith(ENOENT);
    target = static_cast<char const*>(OsPath(path));
    for (int links = 0; links < MOST_LINKS; ++links) {
        char link[PATH_MAX];
        ssize_t const n = ::readlink(target, link, sizeof link);
        if (n < 0) return errno == EINVAL || errno == ENOENT;
        if (n == sizeof link) return failWith(ENAMETOOLONG);
        goTo(link, static_cast<std::uint64_t>(n), target);
    }
    return failWith(ELOOP);
}

Made makeBeside(char const* temporary, char const* target) {
    Descriptor const old(::open(target, O_WRONLY | O_NONBLOCK | O_NOCTTY | O_CLOEXEC));
    if (!old.isOpen() && errno != ENOENT) return Made::FAILED;
    struct stat facts {};
    if (old.isOpen()) {
        if (::fstat(old.get(), &facts) != 0) return Made::FAILED;
        if (!S_ISREG(facts.st_mode)) {
            errno = EINVAL;
            return Made::FAILED;
        }
    }
    mode_t const mode = old.isOpen() ? ONLY_OWNER_READS_AND_WRITES : EVERYONE_READS_AND_WRITES;
    Descriptor const made(::open(temporary, O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC, mode));
    if (!made.isOpen()) return errno == EEXIST ? Made::NAME_TAKEN : Made::FAILED;
    if (old.isOpen()) keepAccess(old.get(), facts, made.get());
    return Made::YES;
}

bool endsFolder(char c) { return c == '/'; }

std::uint64_t processNumber() { return static_cast<std::uint64_t>(::getpid()); }

} // namespace ZOR_Basis
