// The sibling is last_error_win.cpp.

#include "host/xos_basics/last_error.h"

#include <cerrno>

namespace host {

void setLastError(Error error) {
    switch (error) {
    case Error::INJECTED:
        errno = EIO;
        break;
    case Error::BAD_HANDLE:
        errno = EBADF;
        break;
    case Error::BAD_ARGUMENT:
        errno = EINVAL;
        break;
    case Error::NOT_OWNER:
        errno = EPERM;
        break;
    case Error::NOT_FOUND:
        errno = ENOENT;
        break;
    case Error::NO_MEMORY:
        errno = ENOMEM;
        break;
    }
}

unsigned long lastError() { return static_cast<unsigned long>(errno); }

void restoreLastError(unsigned long code) { errno = static_cast<int>(code); }

} // namespace host
