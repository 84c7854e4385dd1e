/// \file
/// `zbTimerDat`: the record of one measurement. Valid C.

#ifndef ZOR_BASIS_TIMERS_TIMER_DAT_H
#define ZOR_BASIS_TIMERS_TIMER_DAT_H

#include "zor_basis/export.h"

#include <stdint.h>

/// Times are readings of the performance counter, in ticks. If all are zero, no measurement is in progress; the end of
/// a measurement sets all to zero.
typedef struct zbTimerDat {
    int64_t start;        ///< reading at the start; 0: not started
    int64_t stop;         ///< reading at the stop
    int64_t suspendStart; ///< reading where the present suspension began; 0: not suspended
    int64_t suspended;    ///< ticks of the suspensions that are over
} zbTimerDat;

#endif
