/// \file
/// Operations on whole directories. Twins: tree_posix.cpp, tree_win.cpp.
///
/// Paths are not null. What fails leaves the system's last error.

#ifndef HOST_XOS_BASICS_DIRECTORIES_TREE_H
#define HOST_XOS_BASICS_DIRECTORIES_TREE_H

namespace host {

/// Fails where anything has that name already.
bool createDirectory(char const* path);

/// Removes a directory, or a link itself.
/// \param recursive  with everything in it; no link is ever followed
bool removeDirectory(char const* path, bool recursive);

/// Copies a directory, its files and, if `recursive`, its directories; a link or another special entry as what it is.
/// Where nothing was, the copy appears when it is complete; in a directory that is there already, its files do.
bool copyDirectory(char const* dst, char const* src, bool overwrite, bool recursive);

/// Renames anything but a regular file within one file system.
/// \param overwrite  a directory in the way is removed, if the move
///     succeeds
bool moveDirectory(char const* dst, char const* src, bool overwrite);

} // namespace host

#endif
