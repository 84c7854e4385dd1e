// The sibling is entry_posix.cpp.

#include "host/xos_basics/files/entry_win.h"

#include <atomic>
#include <cstdio>

namespace host {

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

} // namespace host
