// The sibling is thread_end_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/control/thread_end.h"

namespace host {

namespace {

void WINAPI release(void* calls) { releaseThreadCalls(static_cast<ThreadCalls*>(calls)); }

} // namespace

void releaseAtThreadEnd(ThreadCalls* calls) {
    static DWORD const slot = FlsAlloc(release);
    FlsSetValue(slot, calls);
}

} // namespace host
