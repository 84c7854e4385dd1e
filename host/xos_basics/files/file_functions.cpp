// The functions of one open file, and of files by name.

#include "basis/platform/xos_basics.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/files/open_file.h"
#include "host/xos_basics/files/whole_file.h"
#include "host/xos_basics/result.h"

using host::call;
using host::FAILED;
using host::Function;
using host::given;
using host::OpenFile;
using host::resultOf;

namespace {

/// Null, with the last error set, for the handle 0.
OpenFile* fileOf(xos_File handle) {
    if (handle == 0) host::setLastError(host::Error::BAD_HANDLE);
    return reinterpret_cast<OpenFile*>(static_cast<std::uintptr_t>(handle));
}

} // namespace

xos_File xos_FileOpen(char const* path, uint32_t flags) {
    auto const open = [=]() -> xos_File {
        if (!given(path)) return 0;
        return host::unlessMemoryLacks(xos_File{0}, [&] {
            auto file = std::make_unique<OpenFile>();
            return file->open(path, flags) ? xos_File{reinterpret_cast<std::uintptr_t>(file.release())} : 0;
        });
    };
    return call<xos_File>(Function::xos_FileOpen, 0, open, path, flags);
}

int xos_FileCloseEx(xos_File handle, int reserved) {
    auto const close = [=] {
        OpenFile* const file = fileOf(handle);
        return file != nullptr && file->close() ? 0 : FAILED;
    };
    int const result = call(Function::xos_FileCloseEx, FAILED, close, handle, reserved);
    // A close that fails on demand still closes.
    host::KeepLastError const keep;
    delete fileOf(handle);
    return result;
}

uint64_t xos_FileReadEx(xos_File handle, void* buffer, uint64_t size, int reserved1, int reserved2) {
    auto const read = [=]() -> uint64_t {
        OpenFile* const file = fileOf(handle);
        if (file == nullptr || size == 0 || !given(buffer)) return 0;
        return file->read(static_cast<char*>(buffer), size);
    };
    return call<uint64_t>(Function::xos_FileReadEx, 0, read, handle, buffer, size, reserved1, reserved2);
}

uint64_t xos_FileWriteEx(xos_File handle, void const* buffer, uint64_t size, int reserved1, int reserved2) {
    auto const write = [=]() -> uint64_t {
        OpenFile* const file = fileOf(handle);
        if (file == nullptr || size == 0 || !given(buffer)) return 0;
        return file->write(static_cast<char const*>(buffer), size);
    };
    return call<uint64_t>(Function::xos_FileWriteEx, 0, write, handle, buffer, size, reserved1, reserved2);
}

char* xos_FileGetsEx(xos_File handle, char* buffer, uint64_t size, int reserved) {
    auto const gets = [=]() -> char* {
        OpenFile* const file = fileOf(handle);
        if (file == nullptr || !given(buffer)) return nullptr;
        return file->gets(buffer, size) ? buffer : nullptr;
    };
    return call<char*>(Function::xos_FileGetsEx, nullptr, gets, handle, buffer, size, reserved);
}

int xos_FileFlush(xos_File handle) {
    auto const flush = [=] {
        OpenFile* const file = fileOf(handle);
        return file != nullptr && file->flush() ? 0 : FAILED;
    };
    return call(Function::xos_FileFlush, FAILED, flush, handle);
}

int xos_FileSeekEx(xos_File handle, int64_t offset, int origin, int reserved) {
    auto const seek = [=] {
        OpenFile* const file = fileOf(handle);
        return file != nullptr && file->seek(offset, origin) ? 0 : FAILED;
    };
    return call(Function::xos_FileSeekEx, FAILED, seek, handle, offset, origin, reserved);
}

int64_t xos_FileTellEx(xos_File handle, int reserved) {
    auto const tell = [=]() -> int64_t {
        OpenFile* const file = fileOf(handle);
        return file != nullptr ? file->tell() : -1;
    };
    return call<int64_t>(Function::xos_FileTellEx, -1, tell, handle, reserved);
}

int xos_FileRemove(char const* path, uint32_t flags) {
    auto const remove = [=] { return resultOf([&] { return given(path) && host::removeFile(path); }); };
    return call(Function::xos_FileRemove, FAILED, remove, path, flags);
}

int xos_FileCopy(char const* dst, char const* src, int overwrite) {
    auto const copy = [=] {
        return resultOf([&] { return given(dst, src) && host::copyFile(dst, src, overwrite != 0); });
    };
    return call(Function::xos_FileCopy, FAILED, copy, dst, src, overwrite);
}

int xos_FileMove(char const* dst, char const* src, int overwrite) {
    auto const move = [=] {
        return resultOf([&] { return given(dst, src) && host::moveFile(dst, src, overwrite != 0); });
    };
    return call(Function::xos_FileMove, FAILED, move, dst, src, overwrite);
}

int xos_FileHardLink(char const* src, char const* dst) {
    auto const link = [=] { return resultOf([&] { return given(src, dst) && host::linkFile(src, dst); }); };
    return call(Function::xos_FileHardLink, FAILED, link, src, dst);
}

int xos_FileStatByNameEx(char const* path, xos_Stat* record, uint32_t flags) {
    auto const stat = [=] { return resultOf([&] { return given(path, record) && host::statusOf(path, *record); }); };
    return call(Function::xos_FileStatByNameEx, FAILED, stat, path, record, flags);
}
