/// \file
/// `MultiTaskQueue`: runs each job in its own task, and lists the jobs with their results. The limit is the number of
/// running jobs at which `add` makes further jobs wait. It does not bound how many run: `wait` starts all that are
/// left.
///
/// To bound the number of running jobs, start that many and let each take one piece of work after another:
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
///     if (queue->failed()) report("a page is missing");
///
/// A job is started when a task is created for it, and finishes when its function returns. `add` starts it unless as
/// many jobs run as the limit says; a forced job (`startNow`) starts regardless of the limit. Otherwise it waits.
/// `wait` starts all waiting jobs as soon as one job finishes. If no job runs, `wait` returns immediately, and a job
/// that is waiting then is never started. The first failure marks the queue permanently; the policy decides what
/// follows from it.
///
/// At the end of a job its own task does the book-keeping, under the queue's mutex: it counts the job as finished and,
/// if requested, removes the record and deletes an owned argument. The destructor of such an argument therefore runs on
/// the job's thread and must not wait for another job of the queue.
///
/// \thread one thread adds, waits and walks while jobs run in their tasks; jobs may also add to their queue. One walk
///     at a time. If the platform layer could not make the queue's mutex, the queue is not guarded

#ifndef ZOR_BASIS_SYNC_MULTI_TASK_QUEUE_H
#define ZOR_BASIS_SYNC_MULTI_TASK_QUEUE_H

#include "zor_basis/export.h"
#include "zor_basis/sync/mtq_dat.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API MultiTaskQueue {
public:
    /// What the failure of a job entails.
    enum ErrPolicy : std::uint32_t {
        Continue = 0,    ///< a failure is recorded and changes nothing else
        StopOnError = 1, ///< after a failure no job is accepted and none is started; any other value means the same
    };

    /// Makes a queue.
    /// \param limit  is the number of running jobs at which `add` makes further jobs wait; 0 or less: every job waits
    ///     that is not forced
    /// \return owned by the caller; null if memory is short
    static MultiTaskQueue* New(ErrPolicy policy, int limit);

    MultiTaskQueue(MultiTaskQueue const&) = delete;
    MultiTaskQueue& operator=(MultiTaskQueue const&) = delete;

    /// Deletes all jobs and the arguments that they own. Waits for no job.
    /// \pre no job runs: `wait` has returned, and so has every job that `MTQ_Dat::start` started
    virtual ~MultiTaskQueue();

    /// Appends a job to the list.
    /// \param function  runs in the job's task; not null
    /// \param argument  is passed to the function
    /// \param ownsArgument  says that the argument is an `MTQ_Arg`, passed by its address as an `MTQ_Arg`. It is
    ///     deleted once, together with the job's record, also if the task could not be made. The argument of a refused
    ///     job remains the caller's
    /// \param startNow  starts the job regardless of the limit
    /// \param removeWhenDone  drops the record as soon as the job finishes; false: the queue lists it until its own end
    /// \return true if the job was started or waits. False if it was refused, after a failure or because memory is
    ///     short; also if its task could not be made, which is a failure of the queue, and the job is listed as
    ///     finished
    virtual bool add(MTQ_Dat::Function function, void* argument, bool ownsArgument, bool startNow,
                     bool removeWhenDone) = 0;

    /// Returns when no started job runs; immediately, without starting any, if none does. Jobs that still wait then are
    /// never started by it: call `wait` while jobs run, or force one job.
    /// \kept queue-02: when a job finishes during this call, or has finished since the last `wait` while another still
    ///     runs, all waiting jobs are started together, regardless of the limit
    /// \kept queue-01: a task that could not be made counts as running forever, so this call never returns
    virtual void wait() = 0;

    /// Tells whether a job has returned false or a task could not be made.
    virtual bool failed() = 0;

    /// \name Walking
    /// Return the jobs in the order in which they were added; null at the end. If the record at which the walk stands
    /// is dropped, the walk stands between its neighbours: `current` returns null, and `next` returns the job that
    /// followed.
    /// @{
    virtual MTQ_Dat* first() = 0;
    virtual MTQ_Dat* next() = 0;
    virtual MTQ_Dat* current() = 0;
    /// @}

    /// Reports that a job has finished. The job's task calls it.
    virtual void done(MTQ_Dat& job) = 0;

protected:
    MultiTaskQueue() = default;
};

} // namespace ZOR_Basis

#endif
