/// \file
/// What process_posix.cpp asks of the system, in one table, so that tests can make each call fail.

#ifndef BASIS_SYSTEM_PROCESS_CALLS_POSIX_H
#define BASIS_SYSTEM_PROCESS_CALLS_POSIX_H

#include <poll.h>
#include <spawn.h>
#include <sys/wait.h>

namespace ZOR_Basis {

/// Results and errors as those of the functions of the same purpose: `posix_spawn` gives an error number, the others -1
/// and `errno`.
struct ProcessCalls {
    decltype(&posix_spawn) spawn;
    /// Searches `PATH` for a program without a slash.
    decltype(&posix_spawnp) spawnFromPath;
    decltype(&waitid) waitFor;
    /// A descriptor of a process, readable when it has ended.
    int (*openProcess)(pid_t process);
    decltype(&poll) awaitDescriptor;
    int (*signalDescriptor)(int process, int signal);
    decltype(&kill) signalProcess;
    int (*close)(int descriptor);
};

/// Replaced by tests only, while nothing else runs.
extern ProcessCalls processCalls;

} // namespace ZOR_Basis

#endif
