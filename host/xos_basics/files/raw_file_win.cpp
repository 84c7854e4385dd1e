// The sibling is raw_file_posix.cpp.

#include "host/xos_basics/files/raw_file.h"

#include "host/xos_basics/files/path_win.h"

#include <algorithm>

namespace host {

bool const TEXT_LINES_END_IN_CR_LF = true;

namespace {

constexpr std::size_t LARGEST_TRANSFER = 0x40000000;

HANDLE handleOf(std::intptr_t native) { return reinterpret_cast<HANDLE>(native); }

DWORD pieceOf(std::size_t size) { return static_cast<DWORD>(std::min(size, LARGEST_TRANSFER)); }

} // namespace

bool RawFile::open(char const* path, OpenMode mode) {
    std::wstring wide;
    if (!systemPath(path, wide)) return false;
    DWORD const access = (mode.read ? GENERIC_READ : 0) | (mode.write ? GENERIC_WRITE : 0);
    Handle file{CreateFileW(wide.c_str(), access, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr,
                            mode.create ? OPEN_ALWAYS : OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr)};
    if (!file) return false;
    if (mode.truncate && GetFileType(file.get()) == FILE_TYPE_DISK && SetEndOfFile(file.get()) == 0) return false;
    native_ = reinterpret_cast<std::intptr_t>(file.release());
    append_ = mode.append;
    write_ = mode.write;
    return true;
}

bool RawFile::close() { return CloseHandle(handleOf(std::exchange(native_, -1))) != 0; }

std::ptrdiff_t RawFile::readSome(char* to, std::size_t size) {
    DWORD got = 0;
    if (ReadFile(handleOf(native_), to, pieceOf(size), &got, nullptr) != 0) return static_cast<std::ptrdiff_t>(got);
    // A pipe whose writer has gone has come to its end.
    return GetLastError() == ERROR_BROKEN_PIPE ? 0 : -1;
}

std::size_t RawFile::write(char const* from, std::size_t size) {
    std::size_t done = 0;
    while (done < size) {
        OVERLAPPED end{};
        end.Offset = end.OffsetHigh = 0xFFFFFFFF;
        DWORD put = 0;
        if (WriteFile(handleOf(native_), from + done, pieceOf(size - done), &put, append_ ? &end : nullptr) == 0) {
            break;
        }
        if (put == 0) break;
        done += put;
    }
    return done;
}

bool RawFile::flush() {
    // Pipes, consoles and their like hold nothing back.
    return !write_ || FlushFileBuffers(handleOf(native_)) != 0 || GetFileType(handleOf(native_)) != FILE_TYPE_DISK;
}

std::int64_t RawFile::seek(std::int64_t offset, int origin) {
    static constexpr DWORD ORIGINS[] = {FILE_BEGIN, FILE_CURRENT, FILE_END};
    LARGE_INTEGER distance{};
    LARGE_INTEGER position{};
    distance.QuadPart = offset;
    return SetFilePointerEx(handleOf(native_), distance, &position, ORIGINS[origin]) != 0 ? position.QuadPart : -1;
}

} // namespace host
