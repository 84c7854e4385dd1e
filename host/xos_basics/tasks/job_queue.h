/// \file
/// Jobs that wait for their thread, first come, first served. Not synchronised.

#ifndef HOST_XOS_BASICS_TASKS_JOB_QUEUE_H
#define HOST_XOS_BASICS_TASKS_JOB_QUEUE_H

#include "host/xos_basics/tasks/task_job.h"

namespace host {

struct QueuedJob {
    TaskJob job;
    QueuedJob* next;
};

class JobQueue {
public:
    void push(QueuedJob* job) {
        job->next = nullptr;
        *end_ = job;
        end_ = &job->next;
    }

    /// \return null when there is none
    QueuedJob* pop() {
        QueuedJob* const job = first_;
        if (job != nullptr) remove(&first_);
        return job;
    }

    /// \return false: it is no longer here
    bool remove(QueuedJob const* job) {
        QueuedJob** place = &first_;
        while (*place != nullptr && *place != job) { place = &(*place)->next; }
        if (*place == nullptr) return false;
        remove(place);
        return true;
    }

private:
    void remove(QueuedJob** place) {
        if (end_ == &(*place)->next) end_ = place;
        *place = (*place)->next;
    }

    QueuedJob* first_{nullptr};
    /// Where the next one is hung.
    QueuedJob** end_{&first_};
};

} // namespace host

#endif
