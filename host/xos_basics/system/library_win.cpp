// The sibling is library_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/system/library.h"

#include <algorithm>
#include <string>

namespace host {

void* loadLibrary(char const* name) {
    // With slashes the system would look in its search path only.
    std::string path{name};
    std::replace(path.begin(), path.end(), '/', '\\');
    return LoadLibraryA(path.c_str());
}

} // namespace host
