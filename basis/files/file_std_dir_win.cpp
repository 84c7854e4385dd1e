// The sibling is file_std_dir_posix.cpp.

#include "basis/files/file_backends.h"
#include "basis/files/last_error.h"
#include "basis/files/path_rules.h"
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

/// Runs a call of the runtime on a descriptor. \return -1 where that fails or there is none
template <class Call>
auto onDescriptor(int descriptor, Call call) -> decltype(call(descriptor)) {
    // Never passed to the runtime, which may end the process because of it.
    if (descriptor == -1) {
        refuse(Reason::NOT_OPEN);
        return -1;
    }
    RuntimeCall const runtime;
    auto const result = call(descriptor);
    if (result == -1) runtime.fail();
    return result;
}

int opened(char const* path, int flags) {
    RuntimeCall const call;
    int const descriptor = ::_open(path, flags, OWNER_READS_AND_WRITES);
    if (descriptor == -1) call.fail();
    return descriptor;
}

} // namespace

FileStdDir::FileStdDir(char const* path, int mode) : descriptor_(opened(PathRules::orEmpty(path), flagsOf(mode))) {}

FileStdDir::~FileStdDir() {
    if (descriptor_ == -1) return;
    KeepLastError const keep;
    ::_close(descriptor_);
}

// kept file-01: the runtime's -1 is returned unchanged, as all ones.
std::uint64_t FileStdDir::read(void* buffer, std::uint64_t n) {
    return inPieces(static_cast<char*>(buffer), n, [this](char* to, unsigned piece) {
        return onDescriptor(descriptor_, [=](int from) { return ::_read(from, to, piece); });
    });
}

std::uint64_t FileStdDir::write(void const* buffer, std::uint64_t n) {
    return inPieces(static_cast<char const*>(buffer), n, [this](char const* from, unsigned piece) {
        return onDescriptor(descriptor_, [=](int to) { return ::_write(to, from, piece); });
    });
}

bool FileStdDir::flush() { return onDescriptor(descriptor_, ::_commit) == 0; }

std::int64_t FileStdDir::seek(int origin, int offset) {
    return onDescriptor(descriptor_, [=](int file) { return ::_lseeki64(file, offset, origin); });
}

} // namespace ZOR_Basis
