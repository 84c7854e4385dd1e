// The sibling is thread_end_win.cpp.

#include "host/xos_basics/control/thread_end.h"

#include <pthread.h>

namespace host {

namespace {

void release(void* calls) { releaseThreadCalls(static_cast<ThreadCalls*>(calls)); }

pthread_key_t makeKey() {
    pthread_key_t key{};
    pthread_key_create(&key, release);
    return key;
}

} // namespace

void releaseAtThreadEnd(ThreadCalls* calls) {
    static pthread_key_t const key = makeKey();
    pthread_setspecific(key, calls);
}

} // namespace host
