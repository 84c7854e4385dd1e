/// \file
/// Complete copies of files. For `_win` sources only. A function that fails sets the last error.

#ifndef HOST_XOS_BASICS_FILES_FILE_COPY_WIN_H
#define HOST_XOS_BASICS_FILES_FILE_COPY_WIN_H

#include "host/windows_api.h"

#include <string>

namespace host {

/// Makes `to`, which nothing may bear yet, a complete copy of a file or of a link to one. On failure there is no `to`.
bool copyToNewFile(std::wstring const& from, std::wstring const& to);

/// Copies through a temporary name.
/// \param overwrite  allows a file to be replaced
bool copyFileEntry(std::wstring const& from, std::wstring const& to, bool overwrite);

/// Gives a directory the modification time and the attributes of another.
void keepDirectoryFacts(std::wstring const& directory, WIN32_FILE_ATTRIBUTE_DATA const& source);

} // namespace host

#endif
