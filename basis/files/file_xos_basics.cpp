#include "basis/files/file_backends.h"
#include "basis/files/last_error.h"
#include "basis/files/path_rules.h"
#include "basis/files/platform_flags.h"
#include "zor_basis/files/file.h"

#include <cstring>

namespace ZOR_Basis {
namespace {

std::uint32_t flagsOf(int mode) {
    // The platform layer's text mode, 0x20, is never used: bytes are read back exactly as they were written.
    std::uint32_t flags = 0;
    if ((mode & File::FILE_READ) != 0) flags |= OPEN_READS;
    if ((mode & File::FILE_WRITE) != 0) flags |= OPEN_WRITES;
    if ((mode & File::FILE_TRUNC) != 0) flags |= OPEN_TRUNCATES;
    if ((mode & File::FILE_APPEND) != 0) flags |= OPEN_APPENDS;
    if ((mode & File::FILE_NOCREATEFLAG) == 0) flags |= OPEN_CREATES;
    if ((mode & File::FILE_PLATFORM_EXTRA) != 0) flags |= ENCRYPTED_STORE;
    return flags;
}

} // namespace

FileXosBasics::FileXosBasics(char const* path, int mode)
    : handle_(xos_FileOpen(PathRules::orEmpty(path), flagsOf(mode))) {}

FileXosBasics::~FileXosBasics() {
    if (handle_ == 0) return;
    KeepLastError const keep;
    xos_FileCloseEx(handle_, 0);
}

std::uint64_t FileXosBasics::read(void* buffer, std::uint64_t n) { return xos_FileReadEx(handle_, buffer, n, 0, 0); }

std::uint64_t FileXosBasics::getline(char* buffer, std::uint64_t n) {
    if (n == 0) return 0;
    char const* const line = xos_FileGetsEx(handle_, buffer, n, 0);
    buffer[n - 1] = '\0';
    return line != nullptr ? std::strlen(buffer) : 0;
}

std::uint64_t FileXosBasics::write(void const* buffer, std::uint64_t n) {
    return xos_FileWriteEx(handle_, buffer, n, 0, 0);
}

bool FileXosBasics::flush() { return xos_FileFlush(handle_) == 0; }

std::int64_t FileXosBasics::seek(int origin, int offset) {
    // kept file-02: callers ask for the position, and take 0 for a failure.
    return xos_FileSeekEx(handle_, offset, origin, 0) == 0 ? xos_FileTellEx(handle_, 0) : 0;
}

} // namespace ZOR_Basis
