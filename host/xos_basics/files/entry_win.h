/// \file
/// Steps on single entries that files and trees share. For `_win` sources only. A function that fails sets the last
/// error.

#ifndef HOST_XOS_BASICS_FILES_ENTRY_WIN_H
#define HOST_XOS_BASICS_FILES_ENTRY_WIN_H

#include "host/xos_basics/files/path_win.h"

namespace host {

/// What an entry is, itself and not what it leads to.
struct EntryFacts {
    BY_HANDLE_FILE_INFORMATION information;
    bool link;

    bool isDirectory() const { return !link && (information.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0; }
    bool isSame(EntryFacts const& other) const {
        return information.dwVolumeSerialNumber == other.information.dwVolumeSerialNumber &&
               information.nFileIndexHigh == other.information.nFileIndexHigh &&
               information.nFileIndexLow == other.information.nFileIndexLow;
    }
};

bool factsOf(std::wstring const& path, EntryFacts& facts);

/// The facts of an open entry.
/// \return false when the system does not give them
bool factsOf(HANDLE entry, EntryFacts& facts);

/// Whether the last error says that there is no such entry.
bool isMissing();

/// Makes up a path in the folder of `path` that almost certainly does not exist.
std::wstring temporaryBeside(std::wstring const& path);

/// Removes a file or a link, write-protected or not.
bool removeFileEntry(std::wstring const& path);

/// Removes an empty directory, write-protected or not.
bool removeEmptyDirectory(std::wstring const& path);

/// Renames within one volume.
/// \param overwrite  also in place of a file, write-protected or not
bool renameEntry(std::wstring const& from, std::wstring const& to, bool overwrite);

} // namespace host

#endif
