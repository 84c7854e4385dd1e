/// \file
/// The path by which the system knows an entry once it is open, and the owner of a file handle. For Windows sources
/// only.

#ifndef BASIS_FILES_OPENED_PATH_WIN_H
#define BASIS_FILES_OPENED_PATH_WIN_H

#include "basis/files/last_error.h"
#include "basis/platform/windows_api_win.h"
#include "zor_basis/files/f_path.h"

namespace ZOR_Basis {

constexpr DWORD SHARE_ALL = FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE;

class FileHandle {
public:
    explicit FileHandle(HANDLE handle) : handle_(handle) {}
    FileHandle(FileHandle const&) = delete;
    FileHandle& operator=(FileHandle const&) = delete;
    ~FileHandle() {
        KeepLastError const kept;
        if (isOpen()) CloseHandle(handle_);
    }
    HANDLE get() const { return handle_; }
    bool isOpen() const { return handle_ != INVALID_HANDLE_VALUE; }

private:
    HANDLE const handle_;
};

/// Opens an entry through all links and finds the path of their target.
/// \param found  receives it, in the form "C:\folder\name" or "\\server\share\name"
bool openedPath(char const* path, FPath& found);

} // namespace ZOR_Basis

#endif
