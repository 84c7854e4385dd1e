// The sibling is file_copy_posix.cpp.

#include "host/xos_basics/files/file_copy_win.h"

#include "host/xos_basics/files/entry_win.h"

namespace host {

namespace {

bool setModified(std::wstring const& path, FILETIME const& modified) {
    Handle const entry{CreateFileW(path.c_str(), FILE_WRITE_ATTRIBUTES,
                                   FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr, OPEN_EXISTING,
                                   FILE_FLAG_BACKUP_SEMANTICS | FILE_FLAG_OPEN_REPARSE_POINT, nullptr)};
    return entry && SetFileTime(entry.get(), nullptr, nullptr, &modified) != 0;
}

} // namespace

bool copyToNewFile(std::wstring const& from, std::wstring const& to) {
    WIN32_FILE_ATTRIBUTE_DATA source{};
    if (GetFileAttributesExW(from.c_str(), GetFileExInfoStandard, &source) == 0) return false;
    if (CopyFileExW(from.c_str(), to.c_str(), nullptr, nullptr, nullptr, COPY_FILE_FAIL_IF_EXISTS) == 0) {
        DWORD const error = GetLastError();
        if (error != ERROR_FILE_EXISTS && error != ERROR_ALREADY_EXISTS) removeFileEntry(to);
        return failWith(error);
    }
    if (setModified(to, source.ftLastWriteTime)) return true;
    KeepLastError const keep;
    removeFileEntry(to);
    return false;
}

bool copyFileEntry(std::wstring const& from, std::wstring const& to, bool overwrite) {
    std::wstring const temporary = temporaryBeside(to);
    if (!copyToNewFile(from, temporary)) return false;
    if (renameEntry(temporary, to, overwrite)) return true;
    KeepLastError const keep;
    removeFileEntry(temporary);
    return false;
}

void keepDirectoryFacts(std::wstring const& directory, WIN32_FILE_ATTRIBUTE_DATA const& source) {
    setModified(directory, source.ftLastWriteTime);
    constexpr DWORD KEPT = FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_HIDDEN | FILE_ATTRIBUTE_SYSTEM;
    if ((source.dwFileAttributes & KEPT) != 0) {
        SetFileAttributesW(directory.c_str(), source.dwFileAttributes & KEPT);
    }
}

} // namespace host
