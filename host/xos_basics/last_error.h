/// \file
/// The system's last error, as a platform function leaves it that fails without a system call having failed.
/// Twins: last_error_posix.cpp (errno), last_error_win.cpp (GetLastError).

#ifndef HOST_XOS_BASICS_LAST_ERROR_H
#define HOST_XOS_BASICS_LAST_ERROR_H

namespace host {

enum class Error {
    injected,    ///< EIO; 31, a device that does not work
    badHandle,   ///< EBADF; 6
    badArgument, ///< EINVAL; 87
    notOwner,    ///< EPERM; 288
    notFound,    ///< ENOENT; 2
    noMemory     ///< ENOMEM; 8
};

void setLastError(Error error);

} // namespace host

#endif
