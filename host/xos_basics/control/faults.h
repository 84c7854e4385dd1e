/// \file
/// Which calls are watched: those of a function that must fail, and all in a trace.

#ifndef HOST_XOS_BASICS_CONTROL_FAULTS_H
#define HOST_XOS_BASICS_CONTROL_FAULTS_H

#include "host/xos_basics/control/functions.h"

#include <array>
#include <atomic>
#include <cstdint>

namespace host {

/// Other than 0 if the calls of a function are watched. The failures asked for: the calls to skip in the upper half,
/// the failures in the lower.
extern constinit std::array<std::atomic<std::uint64_t>, FUNCTION_COUNT> faults;

/// Counts one call down.
/// \return whether it fails; the last error is then set
bool takesInjectedFailure(Function function);

inline bool isWatched(Function function) { return faults[indexOf(function)].load(std::memory_order_relaxed) != 0; }

inline bool failsOnDemand(Function function) { return isWatched(function) && takesInjectedFailure(function); }

/// Watches the calls of all functions from now on.
void watchAllCalls();

} // namespace host

#endif
