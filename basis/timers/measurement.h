/// \file
/// The steps of one measurement, on its bare record. A suspension is open where its start is not 0.

#ifndef BASIS_TIMERS_MEASUREMENT_H
#define BASIS_TIMERS_MEASUREMENT_H

#include "basis/ground/clock.h"
#include "zor_basis/timers/timer_dat.h"

namespace ZOR_Basis::Measurement {

inline void suspend(zbTimerDat& record) {
    // kept timers-02: this does not check whether the timer runs.
    if (record.suspendStart == 0) record.suspendStart = PerformanceCounter::now();
}

inline void start(zbTimerDat& record, bool beginSuspended) {
    if (record.start == 0) record.start = PerformanceCounter::now();
    if (beginSuspended) suspend(record);
}

inline void resume(zbTimerDat& record) {
    if (record.suspendStart == 0) return;
    record.suspended += PerformanceCounter::now() - record.suspendStart;
    record.suspendStart = 0;
}

/// Ends the measurement, and an open suspension, at the same reading of the counter.
inline void finish(zbTimerDat& record) {
    record.stop = PerformanceCounter::now();
    if (record.suspendStart <= 0) return;
    record.suspended += record.stop - record.suspendStart;
    record.suspendStart = 0;
}

} // namespace ZOR_Basis::Measurement

#endif
