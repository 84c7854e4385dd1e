// The sibling is raw_file_win.cpp.

#include "host/xos_basics/files/raw_file.h"

#include "host/xos_basics/files/descriptor_posix.h"
#include "host/xos_basics/files/path_posix.h"

#include <algorithm>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace host {

bool const TEXT_LINES_END_IN_CR_LF = false;

namespace {

/// The most that Linux transfers in one call.
constexpr std::size_t LARGEST_TRANSFER = 0x7FFFF000;

int openFlags(OpenMode mode) {
    int flags = O_CLOEXEC | O_NOCTTY;
    flags |= !mode.write ? O_RDONLY : mode.read ? O_RDWR : O_WRONLY;
    if (mode.create) flags |= O_CREAT;
    if (mode.truncate) flags |= O_TRUNC;
    if (mode.append) flags |= O_APPEND;
    return flags;
}

int openInterrupted(char const* path, int flags) {
    int file = -1;
    do { file = ::open(path, flags, 0666); } while (file < 0 && errno == EINTR);
    return file;
}

} // namespace

bool RawFile::open(char const* path, OpenMode mode) {
    Descriptor file{openInterrupted(systemPath(path).c_str(), openFlags(mode))};
    struct stat status {};
    if (!file || ::fstat(file.get(), &status) != 0) return false;
    if (S_ISDIR(status.st_mode)) return failWith(EISDIR);
    native_ = file.release();
    append_ = mode.append;
    write_ = mode.write;
    return true;
}

bool RawFile::close() { return Descriptor{static_cast<int>(std::exchange(native_, -1))}.close(); }

std::ptrdiff_t RawFile::readSome(char* to, std::size_t size) {
    ssize_t got = 0;
    do {
        got = ::read(static_cast<int>(native_), to, std::min(size, LARGEST_TRANSFER));
    } while (got < 0 && errno == EINTR);
    return got;
}

std::size_t RawFile::write(char const* from, std::size_t size) {
    std::size_t done = 0;
    while (done < size) {
        ssize_t const put = ::write(static_cast<int>(native_), from + done, std::min(size - done, LARGEST_TRANSFER));
        if (put < 0 && errno == EINTR) continue;
        if (put <= 0) break;
        done += static_cast<std::size_t>(put);
    }
    return done;
}

bool RawFile::flush() {
    if (!write_ || ::fdatasync(static_cast<int>(native_)) == 0) return true;
    // Pipes, terminals and their like hold nothing back.
    return errno == EINVAL || errno == EROFS || errno == ENOTSUP;
}

std::int64_t RawFile::seek(std::int64_t offset, int origin) {
    static constexpr int ORIGINS[] = {SEEK_SET, SEEK_CUR, SEEK_END};
    return ::lseek(static_cast<int>(native_), offset, ORIGINS[origin]);
}

} // namespace host
