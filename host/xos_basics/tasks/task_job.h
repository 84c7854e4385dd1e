/// \file
/// One task, as its thread receives it.

#ifndef HOST_XOS_BASICS_TASKS_TASK_JOB_H
#define HOST_XOS_BASICS_TASKS_TASK_JOB_H

#include "basis/platform/xos_basics.h"

#include <array>
#include <cstdint>

namespace host {

/// A task's name, cut where it is longer; zero-terminated.
using TaskName = std::array<char, 64>;

struct TaskJob {
    void (*entry)(void*);
    void* argument;
    std::uint64_t stackSize;
    TaskName name;
};

/// \pre `params` and its entry are not null
TaskJob jobOf(xos_TaskParams const& params);

} // namespace host

#endif
