/// \file
/// The system's last error, as a platform function leaves it that fails without a system call having failed.
/// Twins: last_error_posix.cpp (errno), last_error_win.cpp (GetLastError).

#ifndef HOST_XOS_BASICS_LAST_ERROR_H
#define HOST_XOS_BASICS_LAST_ERROR_H

namespace host {

enum class Error {
    INJECTED,     ///< EIO; 31, a device that does not work
    BAD_HANDLE,   ///< EBADF; 6
    BAD_ARGUMENT, ///< EINVAL; 87
    NOT_OWNER,    ///< EPERM; 288
    NOT_FOUND,    ///< ENOENT; 2
    NO_MEMORY     ///< ENOMEM; 8
};

void setLastError(Error error);

/// The system's own code; 0: none.
unsigned long lastError();
void restoreLastError(unsigned long code);

/// The last error while something is cleared away.
class KeepLastError {
public:
    KeepLastError() = default;
    KeepLastError(KeepLastError const&) = delete;
    KeepLastError& operator=(KeepLastError const&) = delete;
    ~KeepLastError() { restoreLastError(code_); }

private:
    unsigned long code_{lastError()};
};

} // namespace host

#endif
