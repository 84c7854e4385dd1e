// The sibling is last_error_win.cpp.

#include "host/xos_basics/last_error.h"

#include <cerrno>

namespace host {

void setLastError(Error error) {
    switch (error) {
    case Error::injected:
        errno = EIO;
        break;
    case Error::badHandle:
        errno = EBADF;
        break;
    case Error::badArgument:
        errno = EINVAL;
        break;
    case Error::notOwner:
        errno = EPERM;
        break;
    case Error::notFound:
        errno = ENOENT;
        break;
    case Error::noMemory:
        errno = ENOMEM;
        break;
    }
}

} // namespace host
