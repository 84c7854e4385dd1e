/// \file
/// Paths as Windows takes them, owners of its handles, and the last error across a clean-up. For `_win` sources only.
///
/// Narrow text is the process's ANSI code page. Text that it cannot express is refused, never replaced.

#ifndef HOST_XOS_BASICS_FILES_PATH_WIN_H
#define HOST_XOS_BASICS_FILES_PATH_WIN_H

#include "host/windows_api.h"
#include "host/xos_basics/files/slashes.h"
#include "host/xos_basics/last_error.h"

#include <string>
#include <utility>

namespace host {

inline bool failWith(DWORD error) {
    SetLastError(error);
    return false;
}
/// Owner of a handle that is closed by `CloseHandle`.
class Handle {
public:
    Handle() = default;
    explicit Handle(HANDLE handle) : handle_(handle) {}
    Handle(Handle&& other) noexcept : handle_(std::exchange(other.handle_, INVALID_HANDLE_VALUE)) {}
    Handle& operator=(Handle&& other) noexcept {
        std::swap(handle_, other.handle_);
        return *this;
    }
    ~Handle() {
        if (*this) {
            KeepLastError const keep;
            CloseHandle(handle_);
        }
    }

    HANDLE get() const { return handle_; }
    HANDLE release() { return std::exchange(handle_, INVALID_HANDLE_VALUE); }
    explicit operator bool() const { return handle_ != INVALID_HANDLE_VALUE; }

private:
    HANDLE handle_ = INVALID_HANDLE_VALUE;
};

/// Converts a path for the system's calls; a long path gets the form without a length limit.
bool systemPath(char const* path, std::wstring& wide);

/// The absolute path in the form that has no limit, without a backslash at its end unless it is a root.
bool fullPath(char const* path, std::wstring& wide);

/// Whether an absolute path is a drive or a share itself.
bool isRoot(std::wstring const& full);

/// The place of the last component in a path; its whole length behind a root.
std::size_t nameOffset(std::wstring const& path);

/// Joins a directory's path and a name.
inline std::wstring joined(std::wstring const& directory, wchar_t const* name) {
    std::wstring path = directory;
    if (!path.empty() && path.back() != L'\\') path += L'\\';
    return path += name;
}

/// Whether an entry only stands for another one.
inline bool isLink(DWORD attributes, DWORD tag) {
    return (attributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0 && IsReparseTagNameSurrogate(tag);
}

} // namespace host

#endif
