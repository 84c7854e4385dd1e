// The sibling is find_control_posix.cpp.

#include "host/control_link/control_link.h"
#include "host/windows_api.h"

namespace host {

void* findControl(char const* name) {
    HMODULE const module = GetModuleHandleA("xos_basics.dll");
    return module == nullptr ? nullptr : reinterpret_cast<void*>(GetProcAddress(module, name));
}

} // namespace host
