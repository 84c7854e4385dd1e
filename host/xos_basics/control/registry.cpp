#include "host/xos_basics/control/registry.h"

#include "host/xos_basics/control/order_stamp.h"
#include "host/xos_basics/control/thread_end.h"

#include <mutex>
#include <new>

namespace host {

constinit QuickMutex registryMutex;
constinit ThreadCalls spareThreadCalls{};
constinit ThreadCalls* registryHead = &spareThreadCalls;
constinit thread_local ThreadCalls* currentThreadCalls = nullptr;
constinit std::array<std::atomic<ThreadCalls*>, FUNCTION_COUNT> soleCaller{};

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

ThreadCalls* adoptThreadCalls() {
    ThreadCalls* const calls = freeOrNewCalls();
    if (calls == nullptr) { return &spareThreadCalls; }
    currentThreadCalls = calls;
    releaseAtThreadEnd(calls);
    return calls;
}

void releaseThreadCalls(ThreadCalls* calls) {
    // Whatever still ends in this thread and calls us gets records anew, and gives them back in the next round.
    currentThreadCalls = nullptr;
    std::lock_guard const lock{registryMutex};
    calls->inUse = false;
}

std::uint64_t stampOfSharedCall(Function function, ThreadCalls& caller) {
    std::atomic<ThreadCalls*>& sole = soleCaller[indexOf(function)];
    ThreadCalls* seen = sole.load(std::memory_order_relaxed);
    if (seen == nullptr && sole.compare_exchange_strong(seen, &caller, std::memory_order_relaxed)) { return 0; }
    if (seen != &spareThreadCalls) {
        // From here on every call is stamped, the former sole caller's too: a call of its that comes after this one
        // sees the mark.
        sole.store(&spareThreadCalls, std::memory_order_relaxed);
    }
    return orderStamp();
}

} // namespace host
