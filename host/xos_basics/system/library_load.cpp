#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/system/library.h"

#include "basis/platform/xos_basics.h"

extern "C" void* xos_LibraryLoad(char const* name) {
    if (host::failsNow(host::Function::xos_LibraryLoad, name)) return nullptr;
    if (name == nullptr || *name == '\0') {
        host::setLastError(host::Error::BAD_ARGUMENT);
        return nullptr;
    }
    return host::loadLibrary(name);
}
