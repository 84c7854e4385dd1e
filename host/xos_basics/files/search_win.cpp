#include "host/xos_basics/files/search_win.h"

namespace host {

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

} // namespace host
