/// \file
/// Failures on demand: which function fails after how many good calls, and how often.

#ifndef HOST_XOS_BASICS_CONTROL_FAULTS_H
#define HOST_XOS_BASICS_CONTROL_FAULTS_H

#include <cstdint>

namespace host {

/// Replaces what was asked for the same function. \return false: no such function, or one that cannot fail
bool injectFailure(char const* name, std::uint32_t skip, std::uint32_t times);

void clearFailures();

/// Takes `NAME:SKIP:TIMES,...`; what is not of that form is reported on standard error and left out.
void injectFailures(char const* list);

} // namespace host

#endif
