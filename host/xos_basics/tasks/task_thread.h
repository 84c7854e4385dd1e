/// \file
/// The system's part of a task's thread. Twins: task_thread_posix.cpp, task_thread_win.cpp.

#ifndef HOST_XOS_BASICS_TASKS_TASK_THREAD_H
#define HOST_XOS_BASICS_TASKS_TASK_THREAD_H

#include "host/xos_basics/tasks/task_job.h"

namespace host {

/// Starts a detached thread.
/// \param stackSize  is the minimum in bytes; 0: the system's usual size
/// \return false if the system cannot make a thread; its last error says why
bool startThread(void (*run)(void*), void* argument, std::uint64_t stackSize);

/// Names the calling thread for debuggers, as far as the system keeps names (15 bytes on Linux).
void nameThisThread(TaskName const& name);

} // namespace host

#endif
