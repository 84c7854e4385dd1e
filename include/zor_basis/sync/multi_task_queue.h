/// \file
/// `MultiTaskQueue`: runs jobs, each in a task of its own, and lists them with their results.
///
///     std::unique_ptr<MultiTaskQueue> queue(MultiTaskQueue::New(MultiTaskQueue::StopOnError, 4));
///     for (Page& page : pages) queue->add(renderPage, &page, false, true, false);
///     queue->wait();
///     if (queue->failed()) ...
///
/// A job waits in the queue until a task is asked for; it runs then, at the same time as everything else, and finishes
/// when its function returns. The limit says how many jobs `add` starts at once; it is no limit of what runs: jobs that are
/// forced start whatever it says, and `wait` starts all that are left, provided that a job runs when it is called: a job
/// that waits in a queue where none runs is started by nobody. The first failure marks the queue for good; what follows
/// from it is the policy's.
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
        Continue = 0,    ///< a failure is remembered, and that is all
        StopOnError = 1, ///< after a failure no job is accepted and none started; so is any other value
    };

    /// \param limit  jobs that run before `add` lets others wait; 0 and less: all wait that are not forced
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
