// The sibling is system_error_posix.cpp.

#include "tests/support/system_error.h"

#include "host/windows_api.h"

int systemError() { return static_cast<int>(GetLastError()); }
void clearSystemError() { SetLastError(0); }

int const INJECTED_ERROR = 31;
