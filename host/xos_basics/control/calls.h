/// \file
/// The record of calls as others read it.

#ifndef HOST_XOS_BASICS_CONTROL_CALLS_H
#define HOST_XOS_BASICS_CONTROL_CALLS_H

#include "host/xos_basics/control/functions.h"

#include <cstdint>
#include <string>

namespace host {

/// Calls since the start or the last reset, over all threads.
std::uint64_t callsOf(Function function);

void resetCalls();

/// Writes the last call's arguments to `text`. \return false: there was no call since the start or the last reset
bool lastCallOf(Function function, std::string& text);

} // namespace host

#endif
