// The sibling is system_error_win.cpp.

#include "tests/support/system_error.h"

#include <cerrno>

int systemError() { return errno; }
void clearSystemError() { errno = 0; }

int const INJECTED_ERROR = EIO;
