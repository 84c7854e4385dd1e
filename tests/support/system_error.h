/// \file
/// The system's last error in tests. Twins: system_error_posix.cpp, system_error_win.cpp.

#ifndef TESTS_SUPPORT_SYSTEM_ERROR_H
#define TESTS_SUPPORT_SYSTEM_ERROR_H

int systemError();
void clearSystemError();

/// What an injected failure leaves.
extern int const INJECTED_ERROR;

#endif
