#include "host/xos_basics/tasks/task_pool.h"

#include "host/xos_basics/control/call_order.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/tasks/task_thread.h"
#include "host/xos_basics/wait/pause.h"
#include "host/xos_basics/wait/quick_mutex.h"
#include "host/xos_basics/wait/word_wait.h"

#include <algorithm>
#include <atomic>
#include <cstring>
#include <memory>
#include <mutex>
#include <new>
#include <thread>

namespace host {

namespace {

/// A thread without a job stays awake for a moment, since waking costs more than most tasks; then it sleeps.
struct Worker {
    TaskJob job;
    /// 1 once a new job has been put in.
    std::atomic<std::uint32_t> hasJob;
    std::uint64_t stackSize;
    Worker* next;
    TaskName lastName;
};

constexpr std::uint32_t NO_JOB = 0;
constexpr std::uint32_t JOB = 1;

/// More idle threads than these end.
constexpr unsigned MOST_IDLE = 64;
/// How long an idle thread stays awake, in looks at its word: some tens of microseconds.
constexpr int AWAKE_LOOKS = 1000;
/// How long a creator waits for a busy thread to come back before it wakes another: less than half a microsecond.
constexpr int CREATOR_LOOKS = 8;

constinit QuickMutex mutex;
constinit Worker* awake = nullptr;
constinit Worker* asleep = nullptr;
constinit unsigned idleCount = 0;
constinit std::atomic<unsigned> awakeCount{0};
constinit std::atomic<unsigned> busyCount{0};

/// A processor is left to the others.
unsigned mostAwake() {
    static unsigned const most = std::max(std::thread::hardware_concurrency(), 1U) - 1;
    return most;
}

/// \pre the mutex is held
void addIdle(Worker*& list, Worker& worker) {
    worker.next = list;
    list = &worker;
    ++idleCount;
}

/// \pre the mutex is held
void removeIdle(Worker** place) {
    *place = (*place)->next;
    --idleCount;
}

/// \pre the mutex is held
Worker* takeFitting(Worker*& list, std::uint64_t stackSize) {
    for (Worker** place = &list; *place != nullptr; place = &(*place)->next) {
        Worker* const worker = *place;
        if (worker->stackSize >= stackSize) {
            removeIdle(place);
            return worker;
        }
    }
    return nullptr;
}

void countAwake(int change) { awakeCount.store(awakeCount.load(std::memory_order_relaxed) + change); }

void waitForQuickWorker() {
    for (int i = 0; i < CREATOR_LOOKS && awakeCount.load(std::memory_order_relaxed) == 0; ++i) {
        if (busyCount.load(std::memory_order_relaxed) == 0 || mostAwake() == 0) { return; }
        pauseBriefly();
    }
}

void handOver(Worker& worker, TaskJob const& job, bool sleeps) {
    busyCount.fetch_add(1, std::memory_order_relaxed);
    worker.job = job;
    worker.hasJob.store(JOB, std::memory_order_release);
    if (sleeps) { wakeOne(worker.hasJob); }
}

bool runOnIdleWorker(TaskJob const& job) {
    waitForQuickWorker();
    Worker* worker = nullptr;
    bool sleeps = false;
    {
        std::lock_guard const lock{mutex};
        worker = takeFitting(awake, job.stackSize);
        if (worker != nullptr) {
            countAwake(-1);
        } else {
            worker = takeFitting(asleep, job.stackSize);
            sleeps = true;
        }
    }
    if (worker == nullptr) { return false; }
    handOver(*worker, job, sleeps);
    return true;
}

/// \return false: there are enough idle threads without this one
bool becomeIdle(Worker& worker, bool& isAwake) {
    worker.hasJob.store(NO_JOB, std::memory_order_relaxed);
    std::lock_guard const lock{mutex};
    if (idleCount >= MOST_IDLE) { return false; }
    isAwake = awakeCount.load(std::memory_order_relaxed) < mostAwake();
    addIdle(isAwake ? awake : asleep, worker);
    if (isAwake) { countAwake(1); }
    return true;
}

/// Moves a thread that has been awake long enough to those that sleep; one that was taken meanwhile gets its job soon.
void fallAsleep(Worker& worker) {
    std::lock_guard const lock{mutex};
    for (Worker** place = &awake; *place != nullptr; place = &(*place)->next) {
        if (*place == &worker) {
            removeIdle(place);
            countAwake(-1);
            addIdle(asleep, worker);
            return;
        }
    }
}

bool seesJob(Worker const& worker) { return worker.hasJob.load(std::memory_order_acquire) == JOB; }

/// \return false: the thread is to end
bool awaitJob(Worker& worker) {
    bool isAwake = false;
    if (!becomeIdle(worker, isAwake)) { return false; }
    for (int i = 0; isAwake && i < AWAKE_LOOKS; ++i) {
        if (seesJob(worker)) { return true; }
        pauseBriefly();
    }
    if (isAwake) { fallAsleep(worker); }
    while (!seesJob(worker)) { waitWhile(worker.hasJob, NO_JOB); }
    return true;
}

void takeName(Worker& worker) {
    if (std::strcmp(worker.lastName.data(), worker.job.name.data()) != 0) {
        nameThisThread(worker.job.name);
        worker.lastName = worker.job.name;
    }
}

void runWorker(void* firstJob) {
    Worker worker{};
    {
        std::unique_ptr<TaskJob> const own{static_cast<TaskJob*>(firstJob)};
        worker.job = *own;
        worker.stackSize = own->stackSize;
    }
    do {
        takeName(worker);
        worker.job.entry(worker.job.argument);
        // What the task called comes before whatever is called after its end.
        publishTime(threadCalls());
        busyCount.fetch_sub(1, std::memory_order_relaxed);
    } while (awaitJob(worker));
}

bool runOnNewWorker(TaskJob const& job) {
    std::unique_ptr<TaskJob> own{new (std::nothrow) TaskJob{job}};
    if (own == nullptr) {
        setLastError(Error::noMemory);
        return false;
    }
    busyCount.fetch_add(1, std::memory_order_relaxed);
    if (!startThread(runWorker, own.get(), job.stackSize)) {
        busyCount.fetch_sub(1, std::memory_order_relaxed);
        return false;
    }
    static_cast<void>(own.release()); // the thread's now
    return true;
}

} // namespace

bool runTask(TaskJob const& job) { return runOnIdleWorker(job) || runOnNewWorker(job); }

} // namespace host
