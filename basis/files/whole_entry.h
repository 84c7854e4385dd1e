/// \file
/// Steps that the operations on whole files and directories have in common.

#ifndef BASIS_FILES_WHOLE_ENTRY_H
#define BASIS_FILES_WHOLE_ENTRY_H

#include "zor_basis/files/f_stat.h"

namespace ZOR_Basis {

/// Removes a file, or a link itself, with the flag of every removal that the library makes for itself.
bool removeFile(char const* path);

bool copyFile(char const* dst, char const* src, bool overwrite);

/// Removes a directory with all its contents.
/// \return true also if nothing exists there
bool removeTree(char const* path);

/// Frees the path of a destination, where the status says that something exists.
/// \param overwrite  removes it: a directory with all its contents, a link itself
/// \error something exists and `overwrite` is false, or it cannot be removed
/// \return whether the path is free
bool freeDestination(char const* path, FStat const& entry, bool overwrite);

/// The same by the present status of the path.
inline bool freeDestination(char const* path, bool overwrite) { return freeDestination(path, FStat(path), overwrite); }

/// Makes `dst` another name of the file `src`, or a copy that replaces an existing file if no link can be made.
bool linkOrCopy(char const* dst, char const* src);

} // namespace ZOR_Basis

#endif
