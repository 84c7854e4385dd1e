/// \file
/// `MultiTaskQueue`: runs each job in a task of its own, and lists the jobs with their results. Its limit is the number of
/// jobs that `add` starts before it lets others wait; it does not bound how many run, as `wait` starts all that are left.
///
/// To bound how many run, start that many jobs and have each take one piece of work after the other:
///
///     struct Pages {
///         std::vector<Page> all;
///         std::atomic<std::size_t> next{0};
///         static bool render(void* argument) {
///             auto& pages = *static_cast<Pages*>(argument);
///             bool good = true;
///             for (std::size_t i; (i = pages.next++) < pages.all.size();) good = pages.all[i].render() && good;
///             return good;
///         }
///     } pages;
///     std::unique_ptr<MultiTaskQueue> queue(MultiTaskQueue::New(MultiTaskQueue::Continue, 4));
///     for (int i = 0; i < 4; ++i) queue->add(Pages::render, &pages, false, true, false);
///     queue->wait(); // never more than four pages at a time
///     if (queue->failed()) ...
///
/// A job that is added waits, is started (a task was created for it) and finishes when its function returns. It waits
/// where `add` finds as many running as the limit says, unless it is forced; `wait` starts all waiting jobs as soon as one
/// job finishes. `wait` returns at once where none runs: a job that waits then is never started. The first failure marks
/// the queue for good; the policy decides what follows from it.
///
/// A job's task does all that its end asks for, under the queue's mutex: it counts the job as finished, and removes its
/// record and deletes an owned argument where that was wanted. The destructor of such an argument therefore runs on the
/// thread of its job and must not wait for another job of the queue.
///
/// \thread  one thread adds, waits and walks while jobs run in their tasks; jobs may add to their queue, too. One walk at a
///     time. A queue whose mutex the platform layer could not make is not guarded.

#ifndef ZOR_BASIS_SYNC_MULTI_TASK_QUEUE_H
#define ZOR_BASIS_SYNC_MULTI_TASK_QUEUE_H

#include "zor_basis/export.h"
#include "zor_basis/sync/mtq_dat.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API MultiTaskQueue {
public:
    enum ErrPolicy : std::uint32_t {
        Continue = 0,    ///< a failure is recorded and changes nothing else
        StopOnError = 1, ///< after a failure no job is accepted and none is started; any other value means the same
    };

    /// \param limit  how many jobs run when `add` begins to let others wait; 0 or less: every job waits that is not forced
    /// \return owned by the caller; null where memory is short
    static MultiTaskQueue* New(ErrPolicy policy, int limit);

    MultiTaskQueue(MultiTaskQueue const&) = delete;
    MultiTaskQueue& operator=(MultiTaskQueue const&) = delete;

    /// Drops all jobs, with the arguments that they own. Waits for no job.
    /// \pre no job runs: `wait` has returned, and so has every job that `MTQ_Dat::start` started
    virtual ~MultiTaskQueue();

    /// Adds a job at the end of the list.
    /// \param function  not null
    /// \param argument  handed to the function
    /// \param ownsArgument  the argument is an `MTQ_Arg`, passed by its address as such; it is deleted together with the
    ///     job's record, once, also where its task could not be made. One that was refused stays the caller's
    /// \param startNow  starts the job whatever the limit
    /// \param removeWhenDone  drops the record as soon as the job finishes, instead of listing it until the queue's end
    /// \return true: started, or waiting. False: refused after a failure, or where memory is short; or the task could not
    ///     be made, which is a failure of the queue, and the job is listed as finished
    virtual bool add(MTQ_Dat::Function function, void* argument, bool ownsArgument, bool startNow,
                     bool removeWhenDone) = 0;

    /// Returns when no started job runs; at once, with nothing started, if none does.
    /// \kept queue-02: when a job finishes meanwhile, or has since the last `wait`, all jobs that wait are started at once,
    ///     whatever the limit
    /// \kept queue-01: a task that could not be made counts as running for ever, so that this never returns
    virtual void wait() = 0;

    /// Whether a job has returned false or a task could not be made.
    virtual bool failed() = 0;

    /// \name Walking
    /// The jobs in the order of their adding; null at the end. A record that is dropped while the walk is at it leaves the
    /// walk between its neighbours: `current` is null, and `next` gives the one that followed.
    /// @{
    virtual MTQ_Dat* first() = 0;
    virtual MTQ_Dat* next() = 0;
    virtual MTQ_Dat* current() = 0;
    /// @}

    /// Reports that a job has finished. Called by its task.
    virtual void done(MTQ_Dat& job) = 0;

protected:
    MultiTaskQueue() = default;
};

} // namespace ZOR_Basis

#endif
