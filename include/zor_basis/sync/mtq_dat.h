/// \file
/// `MTQ_Dat`: one job of a `MultiTaskQueue`; `MTQ_Arg`: the base of arguments that a queue may own.

#ifndef ZOR_BASIS_SYNC_MTQ_DAT_H
#define ZOR_BASIS_SYNC_MTQ_DAT_H

#include "zor_basis/export.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class JobEntry;
class MultiTaskQueue;

/// A job's argument that its queue deletes.
class ZB_API MTQ_Arg {
public:
    virtual ~MTQ_Arg();
};

/// Made and owned by its queue. What it tells may be asked for while the job runs.
///
/// \thread  thread-safe, as long as the queue keeps it
class ZB_API MTQ_Dat {
public:
    /// \return false when the job has failed
    using Function = bool (*)(void* argument);

    MTQ_Dat(MTQ_Dat const&) = delete;
    MTQ_Dat& operator=(MTQ_Dat const&) = delete;

    /// What the job's function returned; false until then.
    bool result() const { return result_.load(std::memory_order_acquire); }
    /// Whether a task has been asked for.
    bool started() const { return started_.load(std::memory_order_acquire); }
    /// Whether the function has returned, or its task could not be made. What the function wrote can be read then.
    bool finished() const { return finished_.load(std::memory_order_acquire); }
    void* argument() const { return argument_; }

    /// Has the queue drop this record when the job finishes; nothing if it has finished already.
    void setRemoveWhenDone() { removeWhenDone_.store(true, std::memory_order_release); }

    /// Gives the job its task, whatever the queue's limit, policy and failures are.
    /// \kept queue-03: the queue counts the end of such a job and not its start: its running count may become -1, `wait`
    ///     does not wait for it, and a task that cannot be made is no failure of the queue
    /// \pre the job has not been started
    /// \return whether the task was made
    bool start();

private:
    friend class JobEntry;

    MTQ_Dat(MultiTaskQueue* queue, Function function, void* argument, bool ownsArgument, bool removeWhenDone)
        : queue_(queue),
          function_(function),
          argument_(argument),
          ownsArgument_(ownsArgument),
          removeWhenDone_(removeWhenDone) {}
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
    /// `start` is at work; the task may come to its end before it.
    std::atomic<bool> starting_{false};
};

} // namespace ZOR_Basis

#endif
