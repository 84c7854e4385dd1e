#include "basis/files/file_backends.h"
#include "basis/files/system_calls.h"
#include "zor_basis/files/file.h"

#include <cstring>
#include <limits>

namespace ZOR_Basis {
namespace {

char const* accessOf(int mode) {
    bool const reads = (mode & File::FILE_READ) != 0;
    bool const writes = (mode & File::FILE_WRITE) != 0;
    if (reads && writes) return (mode & File::FILE_TRUNC) != 0 ? "w+" : "r+";
    if (reads) return "r";
    // kept file-03: appending takes a mode without writing.
    if (writes) return "w";
    return (mode & File::FILE_APPEND) != 0 ? "a+" : "";
}

template <class Char>
std::FILE* openStream(Char const* path, int mode, std::FILE* (*open)(Char const*, char const*)) {
    StreamMode const streamMode(mode);
    return streamMode.text[0] != '\0' ? open(path, streamMode.text) : nullptr;
}

} // namespace

StreamMode::StreamMode(int mode) {
    std::strcpy(text, accessOf(mode));
    if (text[0] == '\0') return;
    std::strcat(text, (mode & File::FILE_SEQUENTIAL) != 0 ? "S" : "R");
    if ((mode & File::FILE_BINARY) != 0) std::strcat(text, "b");
}

FileStdBuf::FileStdBuf(char const* path, int mode) : stream_(openStream(path, mode, systemCalls.openStream)) {}
FileStdBuf::FileStdBuf(WChar const* path, int mode) : stream_(openStream(path, mode, systemCalls.openStreamWide)) {}

FileStdBuf::~FileStdBuf() {
    if (stream_ != nullptr) std::fclose(stream_);
}

std::uint64_t FileStdBuf::read(void* buffer, std::uint64_t n) {
    return stream_ != nullptr ? std::fread(buffer, 1, n, stream_) : 0;
}

std::uint64_t FileStdBuf::getline(char* buffer, std::uint64_t n) {
    if (n == 0) return 0;
    constexpr std::uint64_t LONGEST = std::numeric_limits<int>::max();
    int const room = static_cast<int>(n < LONGEST ? n : LONGEST);
    char const* const line = stream_ != nullptr ? std::fgets(buffer, room, stream_) : nullptr;
    buffer[n - 1] = '\0';
    return line != nullptr ? std::strlen(buffer) : 0;
}

std::uint64_t FileStdBuf::write(void const* buffer, std::uint64_t n) {
    return stream_ != nullptr ? std::fwrite(buffer, 1, n, stream_) : 0;
}

bool FileStdBuf::flush() { return stream_ != nullptr && std::fflush(stream_) == 0; }

std::int64_t FileStdBuf::seek(int origin, int offset) {
    return stream_ != nullptr ? std::fseek(stream_, offset, origin) : -1;
}

} // namespace ZOR_Basis
