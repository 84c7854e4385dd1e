/// \file
/// The calling thread's last error, which tells why a call has failed: `errno`, on Windows that of `GetLastError`.
/// last_error_win.cpp, last_error_posix.cpp.

#ifndef BASIS_FILES_LAST_ERROR_H
#define BASIS_FILES_LAST_ERROR_H

#include <cstdint>

namespace ZOR_Basis {

/// Why the library itself refuses something. docs/reasons.md lists the codes.
enum class Reason {
    ALREADY_THERE,
    IS_DIRECTORY,
    NOT_DIRECTORY,
    NOT_FOUND,
    BAD_ARGUMENT,
    NOT_OPEN,
    NO_MEMORY,
    NO_PROCESS,
    NOT_SUPPORTED,
    LOGON_REFUSED,
};

/// Sets the last error.
/// \return false
bool refuse(Reason reason);

/// The last error at the time of construction.
class LastError {
public:
    LastError();
    /// Sets the last error to it again.
    void restore() const;

private:
    std::uint32_t code_;
};

/// Preserves the reason of a failure during clean-up.
class KeepLastError {
public:
    KeepLastError() = default;
    KeepLastError(KeepLastError const&) = delete;
    KeepLastError& operator=(KeepLastError const&) = delete;
    ~KeepLastError() { kept_.restore(); }

private:
    LastError const kept_;
};

/// Surrounds calls of the runtime library, which on Windows reports its own failures in `errno` only.
class RuntimeCall {
public:
    RuntimeCall();
    /// Makes the reason of the failure the last error.
    void fail() const;
};

} // namespace ZOR_Basis

#endif
