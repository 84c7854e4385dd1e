/// \file
/// What the task of a queued job does.

#ifndef BASIS_SYNC_MTQ_TASK_H
#define BASIS_SYNC_MTQ_TASK_H

namespace ZOR_Basis {

/// Runs a job and reports its end to its queue. \param job  an `MTQ_Dat`
void runQueuedJob(void* job);

} // namespace ZOR_Basis

#endif
