#include "basis/sync/multi_task_queue_impl.h"

#include "basis/memory/node_memory.h"
#include "basis/sync/held_semaphore.h"

#include <thread>

namespace ZOR_Basis {
namespace {

/// The pause between checks of the running jobs if their signal cannot be awaited.
constexpr std::uint32_t LOOK_AGAIN_MS = 1;

/// What the task of a job does. \param job  an `MTQ_Dat`
void runQueuedJob(void* job) {
    auto& entry = static_cast<JobEntry&>(*static_cast<MTQ_Dat*>(job));
    static_cast<MTQ_Impl*>(entry.queue())->run(entry);
}

} // namespace

MTQ_Impl::MTQ_Impl(ErrPolicy policy, int limit)
    : policy_(policy), limit_(limit), mutex_(xos_SemMCreate()), completion_(xos_SemBCreate(0)) {}

MTQ_Impl::~MTQ_Impl() {
    // `wait` may have returned before the last job has given its signal.
    while (ending() != 0) std::this_thread::yield();
    xos_SemDestroy(completion_);
    xos_SemDestroy(mutex_);
    while (JobEntry* const job = jobs_.takeFirst()) deleteNode(jobMemory_, job);
}

bool MTQ_Impl::add(MTQ_Dat::Function function, void* argument, bool ownsArgument, bool startNow, bool removeWhenDone) {
    HeldSemaphore const held(mutex_);
    if (!mayProceed()) return false;
    auto* const job =
        makeNode<JobEntry>(jobMemory_, this, runQueuedJob, function, argument, ownsArgument, removeWhenDone);
    if (job == nullptr) return false;
    jobs_.append(job);
    if (startNow || running() < limit_) return start(*job);
    if (firstWaiting_ == nullptr) firstWaiting_ = job;
    return true;
}

/// \pre the mutex is held
bool MTQ_Impl::start(JobEntry& job) {
    // Its holder takes the mutex again: the platform layer lets the owner do so, and the steps of starting a job, which
    // count and may fail the queue, hold it by themselves.
    HeldSemaphore const held(mutex_);
    running_.fetch_add(1, std::memory_order_relaxed);
    bool const made = job.start();
    // kept queue-01: the job without a task never reports its end, and still counts as running.
    if (!made) failed_.store(true, std::memory_order_release);
    return made;
}

void MTQ_Impl::wait() {
    while (running() > 0) {
        awaitCompletion();
        startAllThatWait();
    }
}

void MTQ_Impl::awaitCompletion() {
    if (xos_SemTake(completion_) != 0) xos_TaskSleep(LOOK_AGAIN_MS);
}

// kept queue-02: the limit counts where jobs are added, not here.
void MTQ_Impl::startAllThatWait() {
    HeldSemaphore const held(mutex_);
    JobEntry* job = firstWaiting_;
    for (; job != nullptr && (job->started() || mayProceed()); job = job->next) {
        if (!job->started()) start(*job);
    }
    firstWaiting_ = job;
}

MTQ_Dat* MTQ_Impl::first() {
    HeldSemaphore const held(mutex_);
    cursor_.moveTo(jobs_.first());
    return current();
}

MTQ_Dat* MTQ_Impl::next() {
    if (cursor_.isNowhere()) return nullptr;
    HeldSemaphore const held(mutex_);
    // The rest of the list may have been dropped meanwhile.
    if (!cursor_.isNowhere()) cursor_.advance();
    return current();
}

void MTQ_Impl::run(JobEntry& job) {
    bool const result = job.callFunction();
    ending_.fetch_add(1, std::memory_order_relaxed);
    job.finish(result);
    done(job);
    ending_.fetch_sub(1, std::memory_order_release);
}

void MTQ_Impl::done(MTQ_Dat& job) {
    {
        HeldSemaphore const held(mutex_);
        if (!job.result()) failed_.store(true, std::memory_order_release);
        auto& entry = static_cast<JobEntry&>(job);
        if (entry.removesWhenDone()) drop(&entry);
        // The last step, because `wait` reads this without the mutex and returns at 0.
        running_.fetch_sub(1, std::memory_order_release);
    }
    xos_SemGive(completion_);
}

/// \pre the mutex is held
void MTQ_Impl::drop(JobEntry* job) {
    cursor_.leave(job);
    if (firstWaiting_ == job) firstWaiting_ = job->next;
    jobs_.unlink(job);
    deleteNode(jobMemory_, job);
}

} // namespace ZOR_Basis
