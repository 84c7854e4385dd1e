/// \file
/// The entries of a directory, one after the other. For `_win` sources only.

#ifndef HOST_XOS_BASICS_FILES_SEARCH_WIN_H
#define HOST_XOS_BASICS_FILES_SEARCH_WIN_H

#include "host/xos_basics/files/path_win.h"

#include <string>

namespace host {

/// A running search for the entries of a directory but "." and "..".
class Search {
public:
    Search() = default;
    Search(Search const&) = delete;
    Search& operator=(Search const&) = delete;
    ~Search() {
        if (search_ != INVALID_HANDLE_VALUE) {
            KeepLastError const keep;
            FindClose(search_);
        }
    }

    /// \return false when there is no such directory
    bool open(std::wstring const& directory);
    /// \return false at the end, with last error 18, and when reading failed
    bool next();

    WIN32_FIND_DATAW const& entry() const { return data_; }
    wchar_t const* name() const { return data_.cFileName; }
    bool isLinkEntry() const { return isLink(data_.dwFileAttributes, data_.dwReserved0); }
    /// A link is none, wherever it leads.
    bool isDirectory() const { return (data_.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0 && !isLinkEntry(); }

private:
    HANDLE search_ = INVALID_HANDLE_VALUE;
    bool unread_ = false;
    WIN32_FIND_DATAW data_{};
};

} // namespace host

#endif
