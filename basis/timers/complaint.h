/// \file
/// How misuse of timers is reported.

#ifndef BASIS_TIMERS_COMPLAINT_H
#define BASIS_TIMERS_COMPLAINT_H

#include "basis/platform/xos_basics.h"

namespace ZOR_Basis {

/// Raises an assertion of the platform layer, which may return.
/// \param line  part of the message, as it is known
inline void complain(int line, char const* message) { xos_Assert(line, "zor_basis", message); }

} // namespace ZOR_Basis

#endif
