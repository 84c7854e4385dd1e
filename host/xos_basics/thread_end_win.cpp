// The sibling is thread_end_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/thread_end.h"

namespace host {

ThreadEnd::ThreadEnd(Call call) : key_(FlsAlloc(call)) {}

void ThreadEnd::set(void* value) const { FlsSetValue(key_, value); }

} // namespace host
