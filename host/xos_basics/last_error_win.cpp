// The sibling is last_error_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/last_error.h"

namespace host {

void setLastError(Error error) {
    switch (error) {
    case Error::injected:
        SetLastError(ERROR_GEN_FAILURE);
        break;
    case Error::badHandle:
        SetLastError(ERROR_INVALID_HANDLE);
        break;
    case Error::badArgument:
        SetLastError(ERROR_INVALID_PARAMETER);
        break;
    case Error::notOwner:
        SetLastError(ERROR_NOT_OWNER);
        break;
    case Error::notFound:
        SetLastError(ERROR_FILE_NOT_FOUND);
        break;
    case Error::noMemory:
        SetLastError(ERROR_NOT_ENOUGH_MEMORY);
        break;
    }
}

} // namespace host
