/// \file
/// Threads for tasks whose creator holds a mutex.
///
/// Such a task would most likely run into that mutex, and a creator of thousands would need thousands of threads that
/// wait for it. So the creator gets the threads when it gives its last mutex or is about to sleep. A creator that waits
/// by other means is helped by a thread that looks some milliseconds later.

#ifndef HOST_XOS_BASICS_TASKS_DEFERRED_THREADS_H
#define HOST_XOS_BASICS_TASKS_DEFERRED_THREADS_H

#include "host/xos_basics/this_thread.h"

namespace host {

using ThreadProvider = void (*)();

/// \param provider  makes the threads later; every call has the same one
/// \return whether the calling thread holds a mutex, so that threads for its tasks come later
bool deferThreads(ThreadProvider provider);

void provideThreadsNow();

/// Provides the threads that the calling thread deferred.
inline void provideDeferredThreads() {
    if (thisThread.hasDeferredThreads) provideThreadsNow();
}

} // namespace host

#endif
