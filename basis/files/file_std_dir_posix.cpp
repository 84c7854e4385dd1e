// The sibling is file_std_dir_win.cpp.

#include "basis/files/file_backends.h"
#include "basis/files/last_error.h"
#include "basis/files/os_path_posix.h"
#include "basis/files/pieces.h"
#include "zor_basis/files/file.h"

#include <fcntl.h>
#include <unistd.h>

namespace ZOR_Basis {
namespace {

constexpr mode_t OWNER_READS_AND_WRITES = 0600;

int flagsOf(int mode) {
    int flags = O_CLOEXEC;
    flags |= (mode & File::FILE_WRITE) != 0 ? O_CREAT | O_RDWR : O_RDONLY;
    if ((mode & File::FILE_APPEND) != 0) flags |= O_APPEND;
    if ((mode & File::FILE_TRUNC) != 0) flags |= O_TRUNC;
    return flags;
}

/// A disk that becomes full accepts a part, and only the next call reports why it did not accept the rest.
ssize_t writeWhole(int descriptor, char const* from, std::size_t n) {
    std::size_t done = 0;
    while (done < n) {
        ssize_t const put = ::write(descriptor, from + done, n - done);
        if (put <= 0) return done != 0 ? static_cast<ssize_t>(done) : put;
        done += static_cast<std::size_t>(put);
    }
    return static_cast<ssize_t>(done);
}

} // namespace

FileStdDir::FileStdDir(char const* path, int mode)
    : descriptor_(::open(OsPath(path), flagsOf(mode), OWNER_READS_AND_WRITES)) {
    if (descriptor_ == -1) return;
    posix_fadvise(descriptor_, 0, 0, (mode & File::FILE_SEQUENTIAL) != 0 ? POSIX_FADV_SEQUENTIAL : POSIX_FADV_RANDOM);
}

FileStdDir::~FileStdDir() {
    if (descriptor_ == -1) return;
    KeepLastError const keep;
    ::close(descriptor_);
}

// kept file-01: the runtime's -1 is returned unchanged, as all ones.
std::uint64_t FileStdDir::read(void* buffer, std::uint64_t n) {
    return inPieces(static_cast<char*>(buffer), n,
                    [this](char* to, unsigned piece) { return ::read(descriptor_, to, piece); });
}

std::uint64_t FileStdDir::write(void const* buffer, std::uint64_t n) {
    return inPieces(static_cast<char const*>(buffer), n,
                    [this](char const* from, unsigned piece) { return writeWhole(descriptor_, from, piece); });
}

bool FileStdDir::flush() { return ::fsync(descriptor_) == 0; }

std::int64_t FileStdDir::seek(int origin, int offset) {
    // The system knows further origins, which look for data and for holes.
    if (origin <= SEEK_END) return ::lseek(descriptor_, offset, origin);
    refuse(Reason::BAD_ARGUMENT);
    return -1;
}

} // namespace ZOR_Basis
