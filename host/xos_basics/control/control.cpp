#include "host/xos_basics/control/control.h"

#include "host/xos_basics/thread_end.h"

#include <mutex>
#include <new>

namespace host {

constinit CallRegistry registry;

namespace {

ThreadCalls* unusedOrNewCalls() {
    std::lock_guard const lock{registry.mutex};
    ThreadCalls* calls = registry.first;
    while (calls != nullptr && calls->inUse) { calls = calls->next; }
    if (calls == nullptr) {
        calls = new (std::nothrow) ThreadCalls();
        if (calls == nullptr) return nullptr;
        calls->next = registry.first;
        registry.first = calls;
    }
    calls->inUse = true;
    return calls;
}

void releaseThreadCalls(void* calls) {
    // A later call while the thread ends adopts records again, and they are released in the next round.
    thisThread.calls = nullptr;
    beginEra();
    std::lock_guard const lock{registry.mutex};
    static_cast<ThreadCalls*>(calls)->inUse = false;
}

} // namespace

ThreadCalls* adoptThreadCalls() {
    static ThreadEnd const end{releaseThreadCalls};
    thisThread.calls = unusedOrNewCalls();
    if (thisThread.calls != nullptr) end.set(thisThread.calls);
    beginEra();
    return thisThread.calls;
}

} // namespace host
