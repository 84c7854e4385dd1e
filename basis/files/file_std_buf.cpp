#include "basis/files/file_backends.h"
#include "basis/files/last_error.h"
#include "basis/files/path_rules.h"
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
    if (streamMode.text[0] != '\0') return open(PathRules::orEmpty(path), streamMode.text);
    refuse(Reason::BAD_ARGUMENT);
    return nullptr;
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
    if (stream_ == nullptr) return;
    KeepLastError const keep;
    std::fclose(stream_);
}

bool FileStdBuf::canBeUsed() const { return stream_ != nullptr || refuse(Reason::NOT_OPEN); }

std::uint64_t FileStdBuf::read(void* buffer, std::uint64_t n) {
    if (!canBeUsed()) return 0;
    RuntimeCall const call;
    std::uint64_t const done = std::fread(buffer, 1, n, stream_);
    if (done < n && std::ferror(stream_) != 0) call.fail();
    return done;
}

std::uint64_t FileStdBuf::getline(char* buffer, std::uint64_t n) {
    if (n == 0) return 0;
    constexpr std::uint64_t LONGEST = std::numeric_limits<int>::max();
    char const* const line = canBeUsed() ? nextLine(buffer, static_cast<int>(n < LONGEST ? n : LONGEST)) : nullptr;
    buffer[n - 1] = '\0';
    return line != nullptr ? std::strlen(buffer) : 0;
}

char const* FileStdBuf::nextLine(char* buffer, int room) {
    RuntimeCall const call;
    char const* const line = std::fgets(buffer, room, stream_);
    if (line == nullptr && std::ferror(stream_) != 0) call.fail();
    return line;
}

std::uint64_t FileStdBuf::write(void const* buffer, std::uint64_t n) {
    if (!canBeUsed()) return 0;
    RuntimeCall const call;
    std::uint64_t const done = std::fwrite(buffer, 1, n, stream_);
    if (done < n) call.fail();
    return done;
}

bool FileStdBuf::flush() {
    if (!canBeUsed()) return false;
    RuntimeCall const call;
    bool const flushed = std::fflush(stream_) == 0;
    if (!flushed) call.fail();
    return flushed;
}

std::int64_t FileStdBuf::seek(int origin, int offset) {
    if (!canBeUsed()) return -1;
    RuntimeCall const call;
    int const result = std::fseek(stream_, offset, origin);
    if (result != 0) call.fail();
    return result;
}

} // namespace ZOR_Basis
