// The sibling is last_error_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/last_error.h"

namespace host {

void setLastError(Error error) {
    switch (error) {
    case Error::INJECTED:
        SetLastError(ERROR_GEN_FAILURE);
        break;
    case Error::BAD_HANDLE:
        SetLastError(ERROR_INVALID_HANDLE);
        break;
    case Error::BAD_ARGUMENT:
        SetLastError(ERROR_INVALID_PARAMETER);
        break;
    case Error::NOT_OWNER:
        SetLastError(ERROR_NOT_OWNER);
        break;
    case Error::NOT_FOUND:
        SetLastError(ERROR_FILE_NOT_FOUND);
        break;
    case Error::NO_MEMORY:
        SetLastError(ERROR_NOT_ENOUGH_MEMORY);
        break;
    }
}

unsigned long lastError() { return GetLastError(); }

void restoreLastError(unsigned long code) { SetLastError(code); }

} // namespace host
