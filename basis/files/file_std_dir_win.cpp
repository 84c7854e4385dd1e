// The sibling is file_std_dir_posix.cpp.

#include "basis/files/file_backends.h"
#include "basis/files/pieces.h"
#include "zor_basis/files/file.h"

#include <fcntl.h>
#include <io.h>

namespace ZOR_Basis {
namespace {

constexpr int OWNER_READS_AND_WRITES = 0x180;

int flagsOf(int mode) {
    int flags = (mode & File::FILE_WRITE) != 0 ? _O_CREAT | _O_RDWR : _O_RDONLY;
    if ((mode & File::FILE_APPEND) != 0) flags |= _O_APPEND;
    if ((mode & File::FILE_TRUNC) != 0) flags |= _O_TRUNC;
    flags |= (mode & File::FILE_BINARY) != 0 ? _O_BINARY : _O_TEXT;
    flags |= (mode & File::FILE_SEQUENTIAL) != 0 ? _O_SEQUENTIAL : _O_RANDOM;
    return flags;
}

} // namespace

FileStdDir::FileStdDir(char const* path, int mode)
    : descriptor_(path != nullptr ? ::_open(path, flagsOf(mode), OWNER_READS_AND_WRITES) : -1) {}

FileStdDir::~FileStdDir() {
    if (descriptor_ != -1) ::_close(descriptor_);
}

// kept file-01: the runtime's -1 comes out as it is, as all ones. No descriptor is never handed to the runtime, which
// may end the process for it.
std::uint64_t FileStdDir::read(void* buffer, std::uint64_t n) {
    if (descriptor_ == -1) return TRANSFER_FAILED;
    return inPieces(static_cast<char*>(buffer), n,
                    [this](char* to, unsigned piece) { return ::_read(descriptor_, to, piece); });
}

std::uint64_t FileStdDir::write(void const* buffer, std::uint64_t n) {
    if (descriptor_ == -1) return TRANSFER_FAILED;
    return inPieces(static_cast<char const*>(buffer), n,
                    [this](char const* from, unsigned piece) { return ::_write(descriptor_, from, piece); });
}

bool FileStdDir::flush() { return descriptor_ != -1 && ::_commit(descriptor_) == 0; }

std::int64_t FileStdDir::seek(int origin, int offset) {
    return descriptor_ != -1 ? ::_lseeki64(descriptor_, offset, origin) : -1;
}

} // namespace ZOR_Basis
