// The sibling is root_folder_posix.cpp.

#include "basis/files/root_folder_impl.h"

#include <direct.h>

namespace ZOR_Basis::RootFolder {

bool const HAS_ONE_FILE_SYSTEM = false;

bool currentFolder(char* out, std::uint64_t size) { return _getcwd(out, static_cast<int>(size)) != nullptr; }

} // namespace ZOR_Basis::RootFolder
