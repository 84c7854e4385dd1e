// The sibling is library_win.cpp.

#include "host/xos_basics/last_error.h"
#include "host/xos_basics/system/library.h"

#include <algorithm>
#include <dlfcn.h>
#include <string>

namespace host {

void* loadLibrary(char const* name) {
    std::string path{name};
    std::replace(path.begin(), path.end(), '\\', '/');
    void* const library = dlopen(path.c_str(), RTLD_NOW);
    if (library == nullptr) setLastError(Error::NOT_FOUND);
    return library;
}

} // namespace host
