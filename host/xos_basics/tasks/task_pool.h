/// \file
/// Threads that are kept for the next task.

#ifndef HOST_XOS_BASICS_TASKS_TASK_POOL_H
#define HOST_XOS_BASICS_TASKS_TASK_POOL_H

#include "host/xos_basics/tasks/task_job.h"

namespace host {

/// Runs the job on a thread of its own: one that is idle, else a new one.
/// \return false: there is none idle and the system gives no new one; the last error is then set
bool runTask(TaskJob const& job);

/// Ensures that no waiting job depends on another's end: makes threads for all jobs that no thread takes soon.
void provideThreads();

} // namespace host

#endif
