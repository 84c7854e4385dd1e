/// \file
/// What the root folder asks of the system: root_folder_win.cpp, root_folder_posix.cpp.

#ifndef BASIS_FILES_ROOT_FOLDER_IMPL_H
#define BASIS_FILES_ROOT_FOLDER_IMPL_H

#include <cstdint>

namespace ZOR_Basis::RootFolder {

/// Whether all absolute paths begin at one place, "/".
extern bool const HAS_ONE_FILE_SYSTEM;

/// Writes the current folder.
/// \return false if it does not fit into `size` bytes or cannot be found
bool currentFolder(char* out, std::uint64_t size);

} // namespace ZOR_Basis::RootFolder

#endif
