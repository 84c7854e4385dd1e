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

bool createFails(xos_TaskParams const* given) {
    xos_TaskParams const params = given == nullptr ? xos_TaskParams{} : *given;
    return failsNow(Function::xos_TaskCreate, params.entry, params.argument, params.options, params.priority,
                    params.stackSize, params.name, params.reserved);
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
    constexpr xos_Task NO_TASK = ~xos_Task{0};
    static constinit std::atomic<xos_Task> lastTask{0};
    if (host::createFails(params)) return NO_TASK;
    if (params == nullptr || params->entry == nullptr) {
        host::setLastError(host::Error::BAD_ARGUMENT);
        return NO_TASK;
    }
    // What the creator called so far comes before what the task calls.
    host::beginEra();
    return host::runTask(host::jobOf(*params)) ? lastTask.fetch_add(1, std::memory_order_relaxed) + 1 : NO_TASK;
}
