#include "host/xos_basics/tasks/task_pool.h"

#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/tasks/deferred_threads.h"
#include "host/xos_basics/tasks/job_queue.h"
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
#include <utility>

namespace host {

namespace {

// A thread is busy with a job, ready (it has none and is about to look for one) or asleep. There are always at least as
// many ready threads as waiting jobs, so no job waits for another's end. A busy thread that ends its job takes the next
// one itself where it can, as waking a thread costs more than most jobs; the thread that was made ready for that job is
// there for the one after.

struct Worker {
    /// 1 once it has been woken.
    std::atomic<std::uint32_t> isWoken;
    Worker* nextAsleep;
    TaskName lastName;
};

/// More sleeping threads than these end.
constexpr unsigned MOST_ASLEEP = 64;
/// How long a ready thread stays awake, in looks at the queue: some tens of microseconds.
constexpr int READY_LOOKS = 1000;
/// How long a creator gives the busy threads before it wakes another: less than half a microsecond.
constexpr int CREATOR_LOOKS = 8;

constinit QuickMutex mutex;
constinit JobQueue queue;
constinit Worker* asleep = nullptr;
constinit unsigned asleepCount = 0;
/// Ready threads that wait for a job awake.
constinit unsigned awakeCount = 0;
/// These three change under the mutex only.
constinit std::atomic<unsigned> waitingJobs{0};
constinit std::atomic<unsigned> readyWorkers{0};
constinit std::atomic<unsigned> busyWorkers{0};

void change(std::atomic<unsigned>& count, int by) {
    count.store(count.load(std::memory_order_relaxed) + static_cast<unsigned>(by), std::memory_order_relaxed);
}

bool areEnoughReady() {
    return waitingJobs.load(std::memory_order_relaxed) <= readyWorkers.load(std::memory_order_relaxed);
}

/// Sees all jobs of those who have read a word that this thread wrote before.
unsigned jobsWithoutThread() {
    std::lock_guard const lock{mutex};
    return areEnoughReady() ? 0 : waitingJobs.load(std::memory_order_relaxed);
}

/// One processor is left to the others.
unsigned mostAwake() {
    static unsigned const most = std::max(std::thread::hardware_concurrency(), 1U) - 1;
    return most;
}

void enqueue(QueuedJob* job) {
    std::lock_guard const lock{mutex};
    queue.push(job);
    change(waitingJobs, 1);
}

/// \pre the mutex is held
std::unique_ptr<QueuedJob> dequeue() {
    std::unique_ptr<QueuedJob> job{queue.pop()};
    if (job != nullptr) change(waitingJobs, -1);
    return job;
}

void giveBusyWorkersAMoment() {
    for (int i = 0; i < CREATOR_LOOKS && !areEnoughReady(); ++i) {
        if (busyWorkers.load(std::memory_order_relaxed) == 0 || mostAwake() == 0) return;
        pauseBriefly();
    }
}

enum class Need { NOTHING, WAKE_UP, NEW_THREAD };

/// Makes one more thread ready, on paper, if there are not enough.
/// \param sleeper  the one to be woken, if any
Need countOnOneMore(Worker*& sleeper) {
    std::lock_guard const lock{mutex};
    if (areEnoughReady()) return Need::NOTHING;
    change(readyWorkers, 1);
    sleeper = asleep;
    if (sleeper == nullptr) return Need::NEW_THREAD;
    asleep = sleeper->nextAsleep;
    --asleepCount;
    return Need::WAKE_UP;
}

/// The thread that was counted on could not be had.
void countOnOneLess() {
    std::lock_guard const lock{mutex};
    change(readyWorkers, -1);
}

/// \return whether it was still waiting
bool takeBack(QueuedJob const* job) {
    std::lock_guard const lock{mutex};
    bool const isWaiting = queue.remove(job);
    change(waitingJobs, isWaiting ? -1 : 0);
    return isWaiting;
}

/// \return the next job for a thread that ends one; none: the thread is ready from now on
std::unique_ptr<QueuedJob> nextOrReady() {
    std::lock_guard const lock{mutex};
    std::unique_ptr<QueuedJob> job = dequeue();
    if (job == nullptr) {
        change(busyWorkers, -1);
        change(readyWorkers, 1);
    }
    return job;
}

/// \pre the calling thread is ready
std::unique_ptr<QueuedJob> tryTake() {
    if (waitingJobs.load(std::memory_order_relaxed) == 0) return nullptr;
    std::lock_guard const lock{mutex};
    std::unique_ptr<QueuedJob> job = dequeue();
    if (job != nullptr) {
        change(readyWorkers, -1);
        change(busyWorkers, 1);
    }
    return job;
}

bool mayStayAwake() {
    std::lock_guard const lock{mutex};
    bool const may = awakeCount < mostAwake();
    awakeCount += may ? 1 : 0;
    return may;
}

void stayedAwake() {
    std::lock_guard const lock{mutex};
    --awakeCount;
}

std::unique_ptr<QueuedJob> takeWhileAwake() {
    std::unique_ptr<QueuedJob> job = tryTake();
    if (job != nullptr || !mayStayAwake()) return job;
    for (int i = 0; i < READY_LOOKS && job == nullptr; ++i) {
        pauseBriefly();
        job = tryTake();
    }
    stayedAwake();
    return job;
}

enum class Rest { THERE_IS_WORK, SLEEP, END };

/// A ready thread may only rest while no job waits.
Rest fallAsleep(Worker& worker) {
    std::lock_guard const lock{mutex};
    if (waitingJobs.load(std::memory_order_relaxed) != 0) return Rest::THERE_IS_WORK;
    change(readyWorkers, -1);
    if (asleepCount >= MOST_ASLEEP) return Rest::END;
    worker.isWoken.store(0, std::memory_order_relaxed);
    worker.nextAsleep = asleep;
    asleep = &worker;
    ++asleepCount;
    return Rest::SLEEP;
}

/// \return null: the thread is to end
std::unique_ptr<QueuedJob> awaitJob(Worker& worker) {
    for (;;) {
        std::unique_ptr<QueuedJob> job = takeWhileAwake();
        if (job != nullptr) return job;
        Rest const rest = fallAsleep(worker);
        if (rest == Rest::END) return nullptr;
        while (rest == Rest::SLEEP && worker.isWoken.load(std::memory_order_acquire) == 0) {
            waitWhile(worker.isWoken, 0);
        }
    }
}

void takeName(Worker& worker, TaskName const& name) {
    if (std::strcmp(worker.lastName.data(), name.data()) != 0) {
        nameThisThread(name);
        worker.lastName = name;
    }
}

void runJob(Worker& worker, std::unique_ptr<QueuedJob> owned) {
    TaskJob const job = owned->job;
    owned.reset(); // a job that never returns keeps nothing
    takeName(worker, job.name);
    job.entry(job.argument);
    // What the task called comes before whatever is called after its end.
    beginEra();
}

/// Runs a first job, if there is one, and then whatever comes, until there is nothing to do for long and for many.
void runJobs(std::unique_ptr<QueuedJob> job) {
    Worker worker{};
    for (;;) {
        if (job == nullptr) job = awaitJob(worker);
        if (job == nullptr) return;
        runJob(worker, std::move(job));
        job = nextOrReady();
    }
}

void runReadyWorker(void*) { runJobs(nullptr); }

void runOwnWorker(void* firstJob) {
    {
        std::lock_guard const lock{mutex};
        change(busyWorkers, 1);
    }
    runJobs(std::unique_ptr<QueuedJob>{static_cast<QueuedJob*>(firstJob)});
}

/// A stack of a certain size is no other thread's.
bool runOnOwnThread(std::unique_ptr<QueuedJob> job) {
    if (!startThread(runOwnWorker, job.get(), job->job.stackSize)) return false;
    static_cast<void>(job.release()); // the thread's now
    return true;
}

/// Makes one more thread ready if there are not enough.
/// \return false: the system gives no new one
bool makeOneMoreReady() {
    Worker* sleeper = nullptr;
    Need const need = countOnOneMore(sleeper);
    if (need == Need::WAKE_UP) {
        sleeper->isWoken.store(1, std::memory_order_release);
        wakeOne(sleeper->isWoken);
    } else if (need == Need::NEW_THREAD && !startThread(runReadyWorker, nullptr, 0)) {
        countOnOneLess();
        return false;
    }
    return true;
}

/// Somebody runs who takes the next job, unless there are others that have to run at the same time.
bool isAnyoneAtWork() {
    return busyWorkers.load(std::memory_order_relaxed) + readyWorkers.load(std::memory_order_relaxed) != 0;
}

bool runOnAnyThread(std::unique_ptr<QueuedJob> owned) {
    QueuedJob* const job = owned.release(); // the queue's, and then its thread's
    enqueue(job);
    if (isAnyoneAtWork() && deferThreads(provideThreads)) return true;
    giveBusyWorkersAMoment();
    if (makeOneMoreReady() || !takeBack(job)) return true;
    owned.reset(job);
    return false;
}

} // namespace

bool runTask(TaskJob const& job) {
    std::unique_ptr<QueuedJob> queued{new (std::nothrow) QueuedJob{job, nullptr}};
    if (queued == nullptr) {
        setLastError(Error::NO_MEMORY);
        return false;
    }
    return job.stackSize == 0 ? runOnAnyThread(std::move(queued)) : runOnOwnThread(std::move(queued));
}

void provideThreads() {
    for (unsigned waiting = jobsWithoutThread(); waiting != 0;) {
        giveBusyWorkersAMoment();
        // While jobs are being taken, another thread would only be in the way.
        unsigned const before = std::exchange(waiting, jobsWithoutThread());
        if (waiting >= before && !makeOneMoreReady()) return;
    }
}

} // namespace host
