/// \file
/// The one kind of `MultiTaskQueue`.

#ifndef BASIS_SYNC_MULTI_TASK_QUEUE_IMPL_H
#define BASIS_SYNC_MULTI_TASK_QUEUE_IMPL_H

#include "basis/containers/linked_list.h"
#include "basis/platform/xos_basics.h"
#include "basis/sync/job_entry.h"
#include "zor_basis/sync/multi_task_queue.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class MemMgr;

class MTQ_Impl final : public MultiTaskQueue {
public:
    MTQ_Impl(ErrPolicy policy, int limit);
    ~MTQ_Impl() override;

    bool add(MTQ_Dat::Function function, void* argument, bool ownsArgument, bool startNow,
             bool removeWhenDone) override;
    void wait() override;
    bool failed() override { return failed_.load(std::memory_order_acquire); }
    MTQ_Dat* first() override;
    MTQ_Dat* next() override;
    MTQ_Dat* current() override { return cursor_.entry(); }
    void done(MTQ_Dat& job) override;

    /// Runs a job from the call of its function to its last access to the queue, on the job's task.
    void run(JobEntry& job);

    std::int32_t running() const { return running_.load(std::memory_order_acquire); }
    /// Jobs whose function has returned and whose `done` has not.
    std::uint32_t ending() const { return ending_.load(std::memory_order_acquire); }

private:
    bool mayProceed() { return policy_ == Continue || !failed(); }
    bool start(JobEntry& job);
    void startAllThatWait();
    void awaitCompletion();
    void drop(JobEntry* job);

    ErrPolicy const policy_;
    std::int32_t const limit_;
    std::atomic<std::int32_t> running_{0};
    xos_Sem const mutex_;
    xos_Sem const completion_;
    LinkedList<JobEntry> jobs_;
    MemMgr* const jobMemory_ = nullptr;
    JobCursor cursor_;
    std::atomic<bool> failed_{false};
    /// No job before this one waits to be started; null: none at all.
    JobEntry* firstWaiting_ = nullptr;
    std::atomic<std::uint32_t> ending_{0};
};

} // namespace ZOR_Basis

#endif
