/// \file
/// `BaseTimer`: one measurement in progress. It keeps no statistics; `stop` adds the finished measurement to a
/// `PileTimer`.
///
///     BaseTimer timer(true, false);
///     render(page);
///     timer.stop(pile);
///
/// The elapsed time is stop - start, including suspensions; the suspended time is counted separately. Misuse is ignored
/// silently; only a pile's own measurement reports it.
///
/// \thread one thread at a time
/// \cost one or two readings of the performance counter and a few stores; no allocation, and no lock except the pile's

#ifndef ZOR_BASIS_TIMERS_BASE_TIMER_H
#define ZOR_BASIS_TIMERS_BASE_TIMER_H

#include "zor_basis/export.h"
#include "zor_basis/timers/timer_dat.h"

#include <cstdint>
#include <type_traits>

namespace ZOR_Basis {

class PileTimer;

ZB_INLINE_PARTS_BEGIN
/// Has the same memory layout as its base, the record.
class ZB_API BaseTimer : public zbTimerDat {
public:
    /// Constructs an idle timer.
    BaseTimer() : zbTimerDat{} {}
    /// \param startNow  starts the timer
    /// \param beginSuspended  starts it suspended; no effect without `startNow`
    BaseTimer(bool startNow, bool beginSuspended);
    BaseTimer(BaseTimer const&) = default;
    BaseTimer(BaseTimer&&) = default;
    BaseTimer& operator=(BaseTimer const&) = default;
    BaseTimer& operator=(BaseTimer&&) = default;

    /// Tell whether a measurement is in progress, and whether it is suspended.
    bool started() const { return zbTimerDat::start > 0; }
    bool isSuspended() const { return suspendStart > 0; }
    /// Returns the ticks from start to stop.
    /// \kept timers-01: 0 after every finished measurement, because `stop` leaves the record idle; the result is
    ///     meaningful only for a record that was filled in another way
    std::int64_t total() const { return zbTimerDat::stop - zbTimerDat::start; }
    /// Returns the ticks of the suspensions that have ended.
    std::int64_t suspended() const { return zbTimerDat::suspended; }

    /// Starts the timer; a running timer keeps its start.
    /// \param beginSuspended  then suspends the timer, whether it ran before or not
    void start(bool beginSuspended);
    /// Opens a suspension, unless one is open.
    /// \kept timers-02: this also works before the start; suspended time from before the start counts, and may exceed
    ///     the elapsed time
    void suspend();
    /// Ends the suspension, if one is open.
    void resume();
    /// Ends the measurement and an open suspension with the same reading, and leaves the timer idle. Does nothing if
    /// the timer is idle.
    /// \param pile  receives the measurement (`PileTimer::addTotal`); null: the measurement is discarded
    void stop(PileTimer* pile);
    /// Makes the timer idle.
    void reset() { static_cast<zbTimerDat&>(*this) = zbTimerDat{}; }

    /// Reads the performance counter, in ticks: `QueryPerformanceCounter` on Windows, the nanoseconds of
    /// `CLOCK_MONOTONIC` elsewhere.
    static std::int64_t Clock();
    /// Queries the counter's ticks per second. The library calls this when it is loaded, and never again.
    /// \kept timers-03: the assertion for a missing counter (line 100) names `PileTimer::Clock()`
    /// \return the system's answer, also after that assertion
    static std::int64_t Init();

protected:
    /// Ticks per second.
    static std::int64_t _freq;
};
ZB_INLINE_PARTS_END

static_assert(sizeof(BaseTimer) == 32 && !std::is_polymorphic_v<BaseTimer>);

} // namespace ZOR_Basis

#endif
