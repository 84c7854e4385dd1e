/// \file
/// What the rooms keep for the calling thread, in one object because some systems look up each one by a call.

#ifndef HOST_XOS_BASICS_THIS_THREAD_H
#define HOST_XOS_BASICS_THIS_THREAD_H

#include <cstdint>

namespace host {

struct ThreadCalls;
struct ThreadStore;

struct ThisThread {
    /// See control/control.h; null before the thread's first call, and again while it ends.
    ThreadCalls* calls;
    /// See semaphores/semaphore_pool.cpp; null before the thread's first semaphore, and again while it ends.
    ThreadStore* store;
    /// The thread as the owner of mutexes; never given twice, 0 before its first one.
    std::uint64_t serial;
    std::uint32_t heldMutexes;
    /// See tasks/deferred_threads.h.
    bool hasDeferredThreads;
};

extern constinit thread_local ThisThread thisThread;

} // namespace host

#endif
