/// \file
/// Locks, and locks by number.

#ifndef ZOR_BASIS_SYNC_H
#define ZOR_BASIS_SYNC_H

#include "zor_basis/sync/lock.h"
#include "zor_basis/sync/sem_set.h"

#endif
