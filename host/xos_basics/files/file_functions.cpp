// The functions of one open file, and of files by name.

#include "basis/platform/xos_basics.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/files/open_file.h"
#include "host/xos_basics/files/whole_file.h"
#include "host/xos_basics/result.h"

using host::FAILED;
using host::failsNow;
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
    if (failsNow(Function::xos_FileOpen, path, flags) || !given(path)) return 0;
    return host::unlessMemoryLacks(xos_File{0}, [&] {
        auto file = std::make_unique<OpenFile>();
        return file->open(path, flags) ? xos_File{reinterpret_cast<std::uintptr_t>(file.release())} : 0;
    });
}

int xos_FileCloseEx(xos_File handle, int reserved) {
    bool const fails = failsNow(Function::xos_FileCloseEx, handle, reserved);
    std::unique_ptr<OpenFile> const file{fileOf(handle)};
    bool const closed = file != nullptr && file->close();
    if (fails) host::setLastError(host::Error::INJECTED);
    return closed && !fails ? 0 : FAILED;
}

uint64_t xos_FileReadEx(xos_File handle, void* buffer, uint64_t size, int reserved1, int reserved2) {
    if (failsNow(Function::xos_FileReadEx, handle, buffer, size, reserved1, reserved2)) return 0;
    OpenFile* const file = fileOf(handle);
    if (file == nullptr || size == 0 || !given(buffer)) return 0;
    return file->read(static_cast<char*>(buffer), size);
}

uint64_t xos_FileWriteEx(xos_File handle, void const* buffer, uint64_t size, int reserved1, int reserved2) {
    if (failsNow(Function::xos_FileWriteEx, handle, buffer, size, reserved1, reserved2)) return 0;
    OpenFile* const file = fileOf(handle);
    if (file == nullptr || size == 0 || !given(buffer)) return 0;
    return file->write(static_cast<char const*>(buffer), size);
}

char* xos_FileGetsEx(xos_File handle, char* buffer, uint64_t size, int reserved) {
    if (failsNow(Function::xos_FileGetsEx, handle, buffer, size, reserved)) return nullptr;
    OpenFile* const file = fileOf(handle);
    if (file == nullptr || !given(buffer)) return nullptr;
    return file->gets(buffer, size) ? buffer : nullptr;
}

int xos_FileFlush(xos_File handle) {
    if (failsNow(Function::xos_FileFlush, handle)) return FAILED;
    OpenFile* const file = fileOf(handle);
    return file != nullptr && file->flush() ? 0 : FAILED;
}

int xos_FileSeekEx(xos_File handle, int64_t offset, int origin, int reserved) {
    if (failsNow(Function::xos_FileSeekEx, handle, offset, origin, reserved)) return FAILED;
    OpenFile* const file = fileOf(handle);
    return file != nullptr && file->seek(offset, origin) ? 0 : FAILED;
}

int64_t xos_FileTellEx(xos_File handle, int reserved) {
    if (failsNow(Function::xos_FileTellEx, handle, reserved)) return -1;
    OpenFile* const file = fileOf(handle);
    return file != nullptr ? file->tell() : -1;
}

int xos_FileRemove(char const* path, uint32_t flags) {
    if (failsNow(Function::xos_FileRemove, path, flags) || !given(path)) return FAILED;
    return resultOf([&] { return host::removeFile(path); });
}

int xos_FileCopy(char const* dst, char const* src, int overwrite) {
    if (failsNow(Function::xos_FileCopy, dst, src, overwrite) || !given(dst, src)) return FAILED;
    return resultOf([&] { return host::copyFile(dst, src, overwrite != 0); });
}

int xos_FileMove(char const* dst, char const* src, int overwrite) {
    if (failsNow(Function::xos_FileMove, dst, src, overwrite) || !given(dst, src)) return FAILED;
    return resultOf([&] { return host::moveFile(dst, src, overwrite != 0); });
}

int xos_FileHardLink(char const* src, char const* dst) {
    if (failsNow(Function::xos_FileHardLink, src, dst) || !given(src, dst)) return FAILED;
    return resultOf([&] { return host::linkFile(src, dst); });
}

int xos_FileStatByNameEx(char const* path, xos_Stat* record, uint32_t flags) {
    if (failsNow(Function::xos_FileStatByNameEx, path, record, flags) || !given(path, record)) return FAILED;
    return resultOf([&] { return host::statusOf(path, *record); });
}
