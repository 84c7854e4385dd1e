/// \file
/// The thread's last error across a clean-up: kept_error_win.cpp, kept_error_posix.cpp.

#ifndef BASIS_FILES_KEPT_ERROR_H
#define BASIS_FILES_KEPT_ERROR_H

#include <cstdint>

namespace ZOR_Basis {

/// Takes the last error of the calling thread (errno, `GetLastError`) and gives it back at its end.
class KeptError {
public:
    KeptError();
    KeptError(KeptError const&) = delete;
    KeptError& operator=(KeptError const&) = delete;
    ~KeptError();

private:
    std::uint32_t const code_;
};

} // namespace ZOR_Basis

#endif
