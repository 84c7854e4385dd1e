#include "host/xos_basics/control/registry.h"

#include "host/xos_basics/control/call_order.h"
#include "host/xos_basics/control/thread_end.h"

#include <mutex>
#include <new>

namespace host {

constinit QuickMutex registryMutex;
constinit ThreadCalls spareThreadCalls{};
constinit ThreadCalls* registryHead = &spareThreadCalls;
constinit thread_local ThreadCalls* currentThreadCalls = nullptr;

namespace {

ThreadCalls* freeOrNewCalls() {
    std::lock_guard const lock{registryMutex};
    for (ThreadCalls* calls = registryHead; calls != nullptr; calls = calls->next) {
        if (!calls->inUse && calls != &spareThreadCalls) {
            calls->inUse = true;
            return calls;
        }
    }
    auto* const made = new (std::nothrow) ThreadCalls();
    if (made != nullptr) {
        made->inUse = true;
        made->next = registryHead;
        registryHead = made;
    }
    return made;
}

} // namespace

void gatherTime() {
    std::lock_guard const lock{registryMutex};
    for (ThreadCalls const* calls = registryHead; calls != nullptr; calls = calls->next) { publishTime(*calls); }
}

ThreadCalls* adoptThreadCalls() {
    ThreadCalls* const calls = freeOrNewCalls();
    if (calls == nullptr) return &spareThreadCalls;
    gatherTime();
    calls->time.store(commonTime.load(std::memory_order_relaxed), std::memory_order_relaxed);
    static constinit std::atomic<std::uint64_t> lastSerial{0};
    calls->threadSerial = lastSerial.fetch_add(1, std::memory_order_relaxed) + 1;
    calls->heldMutexes = 0;
    calls->hasDeferredThreads = false;
    currentThreadCalls = calls;
    releaseAtThreadEnd(calls);
    return calls;
}

void releaseThreadCalls(ThreadCalls* calls) {
    // Whatever still ends in this thread and calls us gets records anew, and gives them back in the next round.
    currentThreadCalls = nullptr;
    publishTime(*calls);
    std::lock_guard const lock{registryMutex};
    calls->inUse = false;
}

} // namespace host
