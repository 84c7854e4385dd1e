// The sibling is file_copy_win.cpp.

#include "host/xos_basics/files/file_copy_posix.h"

#include "host/xos_basics/files/entry_posix.h"

#include <algorithm>
#include <ctime>
#include <fcntl.h>
#include <new>
#include <string>
#include <unistd.h>

namespace host {

mode_t permissionsOfCopy(struct stat const& source) {
    bool const sameOwner = source.st_uid == ::geteuid() && source.st_gid == ::getegid();
    return source.st_mode & (sameOwner ? 07777 : 0777);
}

bool keepModeAndTime(int copy, struct stat const& source) {
    auto const lacking = [] { return errno == EPERM || errno == EOPNOTSUPP || errno == ENOSYS; };
    // A file system without permissions or times of its own has nothing to keep them in.
    if (::fchmod(copy, permissionsOfCopy(source)) != 0 && !lacking()) return false;
    struct timespec const times[2] = {{0, UTIME_OMIT}, source.st_mtim};
    return ::futimens(copy, times) == 0 || lacking();
}

Descriptor openSource(int at, char const* name, int flags, struct stat& status) {
    // Without O_NONBLOCK the open of a pipe would wait for a writer.
    Descriptor source{::openat(at, name, O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY | flags)};
    if (!source || ::fstat(source.get(), &status) != 0) return {};
    if (S_ISREG(status.st_mode)) return source;
    errno = S_ISDIR(status.st_mode) ? EISDIR : EINVAL;
    return {};
}

namespace {

constexpr std::size_t BUFFER_SIZE = 64 * 1024;

bool writeAll(int file, char const* from, std::size_t size) {
    while (size > 0) {
        ssize_t const put = ::write(file, from, size);
        if (put < 0 && errno == EINTR) continue;
        if (put <= 0) return false;
        from += put;
        size -= static_cast<std::size_t>(put);
    }
    return true;
}

/// Whether the kernel's own copy is not to be had here, as opposed to having failed.
bool kernelCannotCopy(int error) {
    return error == EXDEV || error == EINVAL || error == ENOSYS || error == EOPNOTSUPP || error == EBADF ||
           error == EPERM || error == ETXTBSY;
}

} // namespace

bool FileCopier::copyToNew(int source, struct stat const& status, int at, char const* name) {
    Descriptor copy{::openat(at, name, O_WRONLY | O_CREAT | O_EXCL | O_NOFOLLOW | O_CLOEXEC, 0600)};
    if (!copy) return false;
    if (copyContent(source, status, copy.get()) && keepModeAndTime(copy.get(), status) && copy.close()) return true;
    KeepErrno const keep;
    ::unlinkat(at, name, 0);
    return false;
}

bool FileCopier::copyTo(int source, struct stat const& status, int at, char const* name, bool overwrite) {
    std::string const temporary =
        makeTemporary([&](char const* candidate) { return copyToNew(source, status, at, candidate); });
    return !temporary.empty() && putInPlace(at, temporary, name, overwrite);
}

bool FileCopier::copyContent(int source, struct stat const& status, int copy) {
    // One read and one write are cheaper than the kernel's own copy; what claims to be empty may still have content.
    if (status.st_size < static_cast<off_t>(BUFFER_SIZE)) return copyByBuffer(source, copy, -1, status.st_size);
    constexpr off_t BLOCK = 512;
    if (status.st_blocks < status.st_size / BLOCK) return copyHoles(source, status, copy);
    return copyRange(source, copy, -1);
}

bool FileCopier::copyHoles(int source, struct stat const& status, int copy) {
    off_t position = 0;
    for (;;) {
        off_t const data = ::lseek(source, position, SEEK_DATA);
        if (data < 0 && errno == ENXIO) break;
        if (data < 0 && position == 0 && errno == EINVAL) return copyRange(source, copy, -1);
        if (data < 0) return false;
        position = ::lseek(source, data, SEEK_HOLE);
        if (position < 0 || ::lseek(source, data, SEEK_SET) < 0 || ::lseek(copy, data, SEEK_SET) < 0) return false;
        if (!copyRange(source, copy, position - data)) return false;
    }
    // A hole at the end is only a length.
    return position >= status.st_size || ::ftruncate(copy, status.st_size) == 0;
}

bool FileCopier::copyRange(int source, int copy, off_t size) {
    constexpr off_t PIECE = off_t{1} << 30;
    while (size != 0) {
        auto const piece = static_cast<std::size_t>(size < 0 ? PIECE : std::min(size, PIECE));
        ssize_t const got = ::copy_file_range(source, nullptr, copy, nullptr, piece, 0);
        if (got < 0 && errno == EINTR) continue;
        // Some file systems answer 0 for a file whose content they make up: reading is what decides.
        if (got == 0 || (got < 0 && kernelCannotCopy(errno))) return copyByBuffer(source, copy, size, 0);
        if (got < 0) return false;
        if (size > 0) size -= got;
    }
    return true;
}

bool FileCopier::copyByBuffer(int source, int copy, off_t size, off_t expected) {
    if (buffer_ == nullptr) buffer_.reset(new (std::nothrow) char[BUFFER_SIZE]);
    if (buffer_ == nullptr) return failWith(ENOMEM);
    off_t done = 0;
    while (size < 0 || done < size) {
        std::size_t const most =
            size < 0 ? BUFFER_SIZE : static_cast<std::size_t>(std::min(size - done, static_cast<off_t>(BUFFER_SIZE)));
        ssize_t const got = ::read(source, buffer_.get(), most);
        if (got < 0 && errno == EINTR) continue;
        if (got < 0) return false;
        if (got == 0) break;
        if (!writeAll(copy, buffer_.get(), static_cast<std::size_t>(got))) return false;
        done += got;
        // A read that had room to spare and gave all that was expected has met the end.
        if (static_cast<std::size_t>(got) < most && expected > 0 && done >= expected) break;
    }
    return true;
}

} // namespace host
