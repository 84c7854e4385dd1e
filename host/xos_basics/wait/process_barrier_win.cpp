// The sibling is process_barrier_posix.cpp.
// The system's `FlushProcessWriteBuffers` is not used: under Wine it does nothing.

#include "host/xos_basics/wait/process_barrier.h"

namespace host {

bool const hasProcessBarrier = false;

void passProcessBarrier() {}

} // namespace host
