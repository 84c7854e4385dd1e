/// \file
/// `MTQ_Dat`: one job of a `MultiTaskQueue`. `MTQ_Arg`: the base class of arguments that a queue may own.
///
///     for (MTQ_Dat* job = queue->first(); job != nullptr; job = queue->next()) {
///         if (job->finished() && !job->result()) report(job->argument());
///     }

#ifndef ZOR_BASIS_SYNC_MTQ_DAT_H
#define ZOR_BASIS_SYNC_MTQ_DAT_H

#include "zor_basis/export.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class JobEntry;
class MultiTaskQueue;

/// The base class of a job's argument that the queue deletes.
class ZB_API MTQ_Arg {
public:
    virtual ~MTQ_Arg();
};

ZB_INLINE_PARTS_BEGIN
/// The queue makes and owns it. All queries are allowed while the job runs.
///
/// \thread thread-safe, as long as the queue keeps it
class ZB_API MTQ_Dat {
public:
    /// The work of a job.
    /// \return false if the job has failed
    using Function = bool (*)(void* argument);

    MTQ_Dat(MTQ_Dat const&) = delete;
    MTQ_Dat& operator=(MTQ_Dat const&) = delete;

    /// The result of the job's function; false until it has returned.
    bool result() const { return result_.load(std::memory_order_acquire); }
    /// Tells whether a task has been requested.
    bool started() const { return started_.load(std::memory_order_acquire); }
    /// Tells whether the function has returned, or its task could not be made. If so, everything that the function
    /// wrote is visible.
    bool finished() const { return finished_.load(std::memory_order_acquire); }
    void* argument() const { return argument_; }

    /// Makes the queue drop this record when the job finishes; no effect if it has finished already.
    void setRemoveWhenDone() { removeWhenDone_.store(true, std::memory_order_release); }

    /// Creates the job's task, regardless of the queue's limit, policy and failures.
    /// \kept queue-03: the queue counts the end of such a job but not its start: its running count may become -1,
    ///     `wait` does not wait for the job, and a task that cannot be made is not a failure of the queue
    /// \pre the job has not been started
    /// \return whether the task was made
    bool start();

private:
    friend class JobEntry;

    /// What the task of a job does; the argument is the job.
    using Task = void (*)(void* job);

    MTQ_Dat(MultiTaskQueue* queue, Task run, Function function, void* argument, bool ownsArgument, bool removeWhenDone)
        : queue_(queue),
          function_(function),
          argument_(argument),
          ownsArgument_(ownsArgument),
          removeWhenDone_(removeWhenDone),
          run_(run) {}
    ~MTQ_Dat();

    MultiTaskQueue* queue() const { return queue_; }
    bool removesWhenDone() const { return removeWhenDone_.load(std::memory_order_acquire); }
    bool callFunction() const { return function_(argument_); }
    void finish(bool result);

    MultiTaskQueue* const queue_;
    Function const function_;
    void* const argument_;
    std::atomic<bool> started_{false};
    std::atomic<bool> finished_{false};
    bool const ownsArgument_;
    std::atomic<bool> removeWhenDone_;
    std::atomic<bool> result_{false};
    std::atomic<std::uint64_t> task_{0};
    /// `start` is running; the task may end before `start` does.
    std::atomic<bool> starting_{false};
    Task const run_;
};
ZB_INLINE_PARTS_END

} // namespace ZOR_Basis

#endif
