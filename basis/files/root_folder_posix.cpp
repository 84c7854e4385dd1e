// The sibling is root_folder_win.cpp.

#include "basis/files/root_folder_impl.h"

#include <unistd.h>

namespace ZOR_Basis::RootFolder {

bool const HAS_ONE_FILE_SYSTEM = true;

bool currentFolder(char* out, std::uint64_t size) { return getcwd(out, size) != nullptr; }

} // namespace ZOR_Basis::RootFolder
