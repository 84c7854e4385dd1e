/// \file
/// Operations on whole files and on their names. Twins: whole_file_posix.cpp, whole_file_win.cpp.
///
/// Paths are not null. A function that fails sets the system's last error and leaves nothing half done.

#ifndef HOST_XOS_BASICS_FILES_WHOLE_FILE_H
#define HOST_XOS_BASICS_FILES_WHOLE_FILE_H

#include "basis/platform/xos_basics.h"

namespace host {

/// Removes a file or a link, whatever its permissions.
bool removeFile(char const* path);

/// Copies the content, the permissions and the modification time of a regular file. The copy appears under its name
/// when it is complete, or not at all.
bool copyFile(char const* dst, char const* src, bool overwrite);

/// Renames a file or a link within one file system.
bool moveFile(char const* dst, char const* src, bool overwrite);

/// Gives the file `src` the second name `dst`.
bool linkFile(char const* src, char const* dst);

/// Gets the status of an entry, for a link that of the link itself.
bool statusOf(char const* path, xos_Stat& record);

} // namespace host

#endif
