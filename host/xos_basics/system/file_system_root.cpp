#include "host/include/xos_host.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/system/root_setting.h"
#include "host/xos_basics/system/setting.h"

#include "basis/platform/xos_basics.h"

namespace host {

namespace {

constinit Setting root{"XOS_ROOT"};

} // namespace

char const* configuredRoot() { return root.get(); }

} // namespace host

extern "C" {

void xos_HostSetRoot(char const* path) { host::root.set(path); }

char const* xos_FileSystemRoot(void) {
    return host::call<char const*>(host::Function::xos_FileSystemRoot, "", host::configuredRoot);
}

} // extern "C"
