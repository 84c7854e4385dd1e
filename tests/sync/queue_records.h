/// \file
/// Queues, and the records of their jobs in order.

#ifndef TESTS_SYNC_QUEUE_RECORDS_H
#define TESTS_SYNC_QUEUE_RECORDS_H

#include "tests/sync/gated_job.h"

#include <zor_basis/sync.h>

#include <memory>
#include <vector>

using Queue = std::unique_ptr<ZOR_Basis::MultiTaskQueue>;

inline Queue make(ZOR_Basis::MultiTaskQueue::ErrPolicy policy, int limit) {
    return Queue(ZOR_Basis::MultiTaskQueue::New(policy, limit));
}

/// Adds a job whose argument stays the test's.
inline bool add(Queue const& queue, GatedJob& job, bool startNow = false, bool removeWhenDone = false) {
    return queue->add(GatedJob::run, job.argument(), false, startNow, removeWhenDone);
}

inline std::vector<ZOR_Basis::MTQ_Dat*> records(Queue const& queue) {
    std::vector<ZOR_Basis::MTQ_Dat*> all;
    for (ZOR_Basis::MTQ_Dat* record = queue->first(); record != nullptr; record = queue->next()) all.push_back(record);
    return all;
}

#endif
