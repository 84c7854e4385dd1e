/// \file
/// What process_win.cpp asks of the system, in one table, so that tests can make each call fail.

#ifndef BASIS_SYSTEM_PROCESS_CALLS_WIN_H
#define BASIS_SYSTEM_PROCESS_CALLS_WIN_H

#include "basis/platform/windows_api_win.h"

namespace ZOR_Basis {

struct ProcessCalls {
    decltype(&CreateProcessA) createProcess;
    decltype(&OpenProcess) openProcess;
    decltype(&WaitForSingleObject) waitFor;
    decltype(&GetExitCodeProcess) exitCodeOf;
    decltype(&TerminateProcess) terminateProcess;
    decltype(&CloseHandle) closeHandle;
};

/// Replaced by tests only, while nothing else runs.
extern ProcessCalls processCalls;

} // namespace ZOR_Basis

#endif
