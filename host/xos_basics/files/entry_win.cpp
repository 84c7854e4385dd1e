// The sibling is entry_posix.cpp.

#include "host/xos_basics/files/entry_win.h"

#include <atomic>
#include <cstdio>

namespace host {

// Paths

namespace {

/// From here on a path, with a name appended, could pass the limit of the ordinary form.
constexpr std::size_t LONG_PATH = 200;

bool widened(char const* path, std::wstring& wide) {
    if (*path == '\0') return failWith(ERROR_PATH_NOT_FOUND);
    int const size = MultiByteToWideChar(CP_ACP, MB_ERR_INVALID_CHARS, path, -1, nullptr, 0);
    if (size == 0) return false;
    wide.resize(static_cast<std::size_t>(size));
    MultiByteToWideChar(CP_ACP, MB_ERR_INVALID_CHARS, path, -1, wide.data(), size);
    wide.pop_back();
    unifySlashes(wide, L'\\');
    return true;
}

bool hasPrefix(std::wstring const& path) {
    return path.compare(0, 4, L"\\\\?\\") == 0 || path.compare(0, 4, L"\\\\.\\") == 0;
}

bool makeFull(std::wstring& path) {
    if (hasPrefix(path)) return true;
    std::wstring full;
    for (DWORD size = GetFullPathNameW(path.c_str(), 0, nullptr, nullptr);;) {
        if (size == 0) return false;
        full.resize(size);
        DWORD const length = GetFullPathNameW(path.c_str(), size, full.data(), nullptr);
        if (length < size) {
            full.resize(length);
            if (length == 0) return false;
            break;
        }
        size = length;
    }
    bool const share = full.compare(0, 2, L"\\\\") == 0;
    path = share ? L"\\\\?\\UNC\\" + full.substr(2) : L"\\\\?\\" + full;
    return true;
}

/// Where the last two letters are a drive, the slash behind them belongs to it.
void cutEnd(std::wstring& path) {
    cutEndSlashes(path);
    if (path.back() == L':') path += L'\\';
}

} // namespace

bool systemPath(char const* path, std::wstring& wide) {
    return widened(path, wide) && (wide.size() < LONG_PATH || makeFull(wide));
}

bool fullPath(char const* path, std::wstring& wide) {
    if (!widened(path, wide) || !makeFull(wide)) return false;
    cutEnd(wide);
    return true;
}

bool isRoot(std::wstring const& full) {
    if (full.back() == L'\\') return true;
    if (full.compare(0, 8, L"\\\\?\\UNC\\") != 0) return false;
    std::size_t const share = full.find(L'\\', 8);
    return share == std::wstring::npos || full.find(L'\\', share + 1) == std::wstring::npos;
}

std::size_t nameOffset(std::wstring const& path) {
    std::size_t const separator = path.find_last_of(L"\\:");
    return separator == std::wstring::npos ? 0 : separator + 1;
}

bool Search::open(std::wstring const& directory) {
    DWORD const attributes = GetFileAttributesW(directory.c_str());
    if (attributes == INVALID_FILE_ATTRIBUTES) return false;
    if ((attributes & FILE_ATTRIBUTE_DIRECTORY) == 0) return failWith(ERROR_DIRECTORY);
    search_ = FindFirstFileExW(joined(directory, L"*").c_str(), FindExInfoStandard, &data_, FindExSearchNameMatch,
                               nullptr, FIND_FIRST_EX_LARGE_FETCH);
    unread_ = search_ != INVALID_HANDLE_VALUE;
    // The root of an empty drive has not even the two names that every other directory has.
    return unread_ || GetLastError() == ERROR_FILE_NOT_FOUND;
}

bool Search::next() {
    for (;;) {
        if (search_ == INVALID_HANDLE_VALUE) return failWith(ERROR_NO_MORE_FILES);
        if (!unread_ && FindNextFileW(search_, &data_) == 0) return false;
        unread_ = false;
        if (!isDots(name())) return true;
    }
}

// Entries

bool factsOf(HANDLE entry, EntryFacts& facts) {
    facts = {};
    if (GetFileInformationByHandle(entry, &facts.information) == 0) return false;
    FILE_ATTRIBUTE_TAG_INFO tag{};
    facts.link = (facts.information.dwFileAttributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0 &&
                 GetFileInformationByHandleEx(entry, FileAttributeTagInfo, &tag, sizeof tag) != 0 &&
                 isLink(tag.FileAttributes, tag.ReparseTag);
    return true;
}

bool factsOf(std::wstring const& path, EntryFacts& facts) {
    Handle const entry{CreateFileW(path.c_str(), FILE_READ_ATTRIBUTES,
                                   FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr, OPEN_EXISTING,
                                   FILE_FLAG_BACKUP_SEMANTICS | FILE_FLAG_OPEN_REPARSE_POINT, nullptr)};
    return entry && factsOf(entry.get(), facts);
}

bool isMissing() {
    DWORD const error = GetLastError();
    return error == ERROR_FILE_NOT_FOUND || error == ERROR_PATH_NOT_FOUND;
}

std::wstring temporaryBeside(std::wstring const& path) {
    static std::atomic<unsigned> counter{0};
    LARGE_INTEGER ticks{};
    QueryPerformanceCounter(&ticks);
    wchar_t name[64];
    std::swprintf(name, 64, L".xos-%x-%x-%x.tmp", static_cast<unsigned>(GetCurrentProcessId()),
                  counter.fetch_add(1, std::memory_order_relaxed), static_cast<unsigned>(ticks.LowPart));
    return path.substr(0, nameOffset(path)) + name;
}

namespace {

/// Runs a step again without the entry's write protection, which comes back when the step fails all the same.
template <class Step>
bool despiteProtection(std::wstring const& path, Step step) {
    if (step()) return true;
    if (GetLastError() != ERROR_ACCESS_DENIED) return false;
    DWORD const attributes = GetFileAttributesW(path.c_str());
    if (attributes == INVALID_FILE_ATTRIBUTES || (attributes & FILE_ATTRIBUTE_READONLY) == 0) {
        return failWith(ERROR_ACCESS_DENIED);
    }
    SetFileAttributesW(path.c_str(), attributes & ~static_cast<DWORD>(FILE_ATTRIBUTE_READONLY));
    if (step()) return true;
    KeepLastError const keep;
    SetFileAttributesW(path.c_str(), attributes);
    return false;
}

/// For an entry that is gone or that another program holds, the plain call says what is wrong.
bool isDirectoryLink(std::wstring const& path) {
    EntryFacts facts{};
    return factsOf(path, facts) && facts.link && (facts.information.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0;
}

} // namespace

bool removeFileEntry(std::wstring const& path) {
    if (isDirectoryLink(path)) return removeEmptyDirectory(path);
    return despiteProtection(path, [&] { return DeleteFileW(path.c_str()) != 0; });
}

bool removeEmptyDirectory(std::wstring const& path) {
    return despiteProtection(path, [&] { return RemoveDirectoryW(path.c_str()) != 0; });
}

bool renameEntry(std::wstring const& from, std::wstring const& to, bool overwrite) {
    if (!overwrite) return MoveFileExW(from.c_str(), to.c_str(), 0) != 0;
    return despiteProtection(to, [&] { return MoveFileExW(from.c_str(), to.c_str(), MOVEFILE_REPLACE_EXISTING) != 0; });
}

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
