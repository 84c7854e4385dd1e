#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/system/library.h"

#include "basis/platform/xos_basics.h"

extern "C" void* xos_LibraryLoad(char const* name) {
    auto const load = [=]() -> void* {
        if (name != nullptr && *name != '\0') return host::loadLibrary(name);
        host::setLastError(host::Error::BAD_ARGUMENT);
        return nullptr;
    };
    return host::call<void*>(host::Function::xos_LibraryLoad, nullptr, load, name);
}
