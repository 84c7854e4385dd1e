// The sibling is thread_end_win.cpp.

#include "host/xos_basics/thread_end.h"

#include <pthread.h>

namespace host {

static_assert(sizeof(pthread_key_t) == sizeof(std::uint32_t));

ThreadEnd::ThreadEnd(Call call) { pthread_key_create(&key_, call); }

void ThreadEnd::set(void* value) const { pthread_setspecific(key_, value); }

} // namespace host
