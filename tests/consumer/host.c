/* A program that steers the stand-alone platform layer: it makes the library's next move fail, and counts calls. */

#include <xos_host.h>
#include <zor_basis/flat.h>

#include <stdio.h>
#include <string.h>

int main(void) {
    int known = xos_HostFail("xos_FileMove", 0, 1) == 0;
    int unknown = xos_HostFail("xos_NoSuchFunction", 0, 1) == -1;
    int good = known && unknown && xos_HostCalls("xos_FileMove") == 0 && strcmp(ZB_baseNamePosition("a/b"), "b") == 0;
    xos_HostFailClear();
    puts(good ? "consumer_host: good" : "consumer_host: bad");
    return good ? 0 : 1;
}
