/* A module for MSVC's linker: without a C library, so that any machine can compile and link it. Ends with 0 if good. */

#include <xos_host.h>
#include <zor_basis/flat.h>

int start(void) {
    char const* name = ZB_baseNamePosition("tray/page");
    return name != 0 && *name == 'p' && xos_HostFail("xos_NoSuchFunction", 0, 1) == -1 ? 0 : 1;
}
