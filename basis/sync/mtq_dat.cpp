#include "zor_basis/sync/mtq_dat.h"

#include "basis/platform/xos_basics.h"

#include <thread>

namespace ZOR_Basis {
namespace {

constexpr xos_Task NO_TASK = ~xos_Task{0};
constexpr std::int32_t PRIORITY = -9;
constexpr char TASK_NAME[] = "MTQ_Dat::start";

} // namespace

MTQ_Arg::~MTQ_Arg() = default;

MTQ_Dat::~MTQ_Dat() {
    while (starting_.load(std::memory_order_acquire)) std::this_thread::yield();
    if (ownsArgument_) delete static_cast<MTQ_Arg*>(argument_);
}

// kept queue-03: the queue, which counts its jobs, is not informed.
bool MTQ_Dat::start() {
    starting_.store(true, std::memory_order_relaxed);
    started_.store(true, std::memory_order_release);
    xos_TaskParams const params{run_, this, 0, PRIORITY, 0, TASK_NAME, 0};
    xos_Task const task = xos_TaskCreate(&params);
    bool const made = task != NO_TASK;
    task_.store(task, std::memory_order_relaxed);
    if (!made) finished_.store(true, std::memory_order_release);
    // The last access to the record, which may be dropped from now on.
    starting_.store(false, std::memory_order_release);
    return made;
}

void MTQ_Dat::finish(bool result) {
    result_.store(result, std::memory_order_release);
    finished_.store(true, std::memory_order_release);
}

} // namespace ZOR_Basis
