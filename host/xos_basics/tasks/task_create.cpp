#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/tasks/task_pool.h"

#include <algorithm>
#include <atomic>
#include <cstring>

namespace host {

namespace {

/// What a debugger shows for a task without a name.
constexpr char const* const NAMELESS = "xos_task";

constexpr xos_Task NO_TASK = ~xos_Task{0};

xos_Task create(xos_TaskParams const& params) {
    static constinit std::atomic<xos_Task> lastTask{0};
    if (params.entry == nullptr) {
        setLastError(Error::BAD_ARGUMENT);
        return NO_TASK;
    }
    // What the creator called so far comes before what the task calls.
    beginEra();
    return runTask(jobOf(params)) ? lastTask.fetch_add(1, std::memory_order_relaxed) + 1 : NO_TASK;
}

} // namespace

TaskJob jobOf(xos_TaskParams const& params) {
    TaskJob job{params.entry, params.argument, params.stackSize, {}};
    char const* const name = params.name == nullptr ? NAMELESS : params.name;
    std::memcpy(job.name.data(), name, std::min(std::strlen(name), job.name.size() - 1));
    return job;
}

} // namespace host

extern "C" xos_Task xos_TaskCreate(xos_TaskParams const* params) {
    xos_TaskParams const task = params == nullptr ? xos_TaskParams{} : *params;
    auto const create = [&] { return host::create(task); };
    return host::call(host::Function::xos_TaskCreate, host::NO_TASK, create, task.entry, task.argument, task.options,
                      task.priority, task.stackSize, task.name, task.reserved);
}
