/// \file
/// All threads' records, living and dead.

#ifndef HOST_XOS_BASICS_CONTROL_REGISTRY_H
#define HOST_XOS_BASICS_CONTROL_REGISTRY_H

#include "host/xos_basics/control/call_record.h"

#include "host/xos_basics/wait/quick_mutex.h"

namespace host {

/// Guards the list and everything in it that is not atomic.
extern constinit QuickMutex registryMutex;
/// Newest first.
extern constinit ThreadCalls* registryHead;

/// Makes the calls that follow, in whatever thread, later than all that were made.
void gatherTime();

} // namespace host

#endif
