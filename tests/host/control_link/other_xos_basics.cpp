// A module of the same name, without control functions.

#include "basis/platform/xos_basics.h"
#include "tests/host/control_link/answers.h"

int xos_StrCmp(char const*, char const*) { return OTHER_BASICS; }
