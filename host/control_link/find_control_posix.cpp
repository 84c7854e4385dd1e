// The sibling is find_control_win.cpp.

#include "host/control_link/control_link.h"

#include <dlfcn.h>

namespace host {

void* findControl(char const* name) {
    void* const found = dlsym(RTLD_DEFAULT, name);
    if (found != nullptr) return found;
    // A module that was loaded for one caller only is not among the process's common names.
    void* const module = dlopen("libxos_basics.so", RTLD_LAZY | RTLD_NOLOAD);
    if (module == nullptr) return nullptr;
    void* const own = dlsym(module, name);
    dlclose(module);
    return own;
}

} // namespace host
