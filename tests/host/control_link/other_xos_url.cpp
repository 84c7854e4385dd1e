// A module of the same name.

#include "basis/platform/xos_url.h"
#include "tests/host/control_link/answers.h"

int xos_URLGet(char const*, char const*, char const*, char const*) { return OTHER_URL; }
