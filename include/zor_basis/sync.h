/// \file
/// Locks, locks by number, and a queue of jobs.

#ifndef ZOR_BASIS_SYNC_H
#define ZOR_BASIS_SYNC_H

#include "zor_basis/sync/lock.h"
#include "zor_basis/sync/multi_task_queue.h"
#include "zor_basis/sync/sem_set.h"

#endif
