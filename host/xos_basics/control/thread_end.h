/// \file
/// A call at the end of the calling thread. Twins: thread_end_posix.cpp, thread_end_win.cpp.

#ifndef HOST_XOS_BASICS_CONTROL_THREAD_END_H
#define HOST_XOS_BASICS_CONTROL_THREAD_END_H

namespace host {

struct ThreadCalls;

/// Hands `calls` to `releaseThreadCalls` when the calling thread ends.
void releaseAtThreadEnd(ThreadCalls* calls);

/// Makes the records available to the next new thread.
void releaseThreadCalls(ThreadCalls* calls);

} // namespace host

#endif
