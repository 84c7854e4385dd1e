/// \file
/// `BaseTimer`: one measurement in progress. It keeps no statistics; a finished measurement is handed to a `PileTimer`.
///
/// Elapsed time is stop − start, suspensions included; the suspended time goes beside it. Misuse is absorbed in silence;
/// only a pile's own measurement complains.
///
/// \thread  one thread at a time
/// \cost  a reading of the performance counter or two and a few stores; no memory, and no lock but the pile's

#ifndef ZOR_BASIS_TIMERS_BASE_TIMER_H
#define ZOR_BASIS_TIMERS_BASE_TIMER_H

#include "zor_basis/export.h"
#include "zor_basis/timers/timer_dat.h"

#include <cstdint>
#include <type_traits>

namespace ZOR_Basis {

class PileTimer;

/// The same in memory as the record that it is.
class ZB_API BaseTimer : public zbTimerDat {
public:
    /// Idle.
    BaseTimer() : zbTimerDat{} {}
    /// \param startNow  starts
    /// \param beginSuspended  in suspension; without `startNow` it means nothing
    BaseTimer(bool startNow, bool beginSuspended);
    BaseTimer(BaseTimer const&) = default;
    BaseTimer(BaseTimer&&) = default;
    BaseTimer& operator=(BaseTimer const&) = default;
    BaseTimer& operator=(BaseTimer&&) = default;

    bool started() const { return zbTimerDat::start > 0; }
    bool isSuspended() const { return suspendStart > 0; }
    /// The ticks from start to stop.
    /// \kept timers-01: 0 after every finished measurement, as `stop` leaves the record idle; it tells something only of
    ///     a record that was filled in another way
    std::int64_t total() const { return zbTimerDat::stop - zbTimerDat::start; }
    /// The ticks of the suspensions that are over.
    std::int64_t suspended() const { return zbTimerDat::suspended; }

    /// Starts; a timer that runs keeps its start.
    /// \param beginSuspended  then suspends, whether it ran before or not
    void start(bool beginSuspended);
    /// Opens a suspension, unless one is open.
    /// \kept timers-02: also before the start; what was suspended then counts, and may exceed the elapsed time
    void suspend();
    /// Ends the suspension, if one is open.
    void resume();
    /// Ends the measurement and the suspension that is open, at one reading, and leaves the timer idle. Idle already,
    /// it does nothing.
    /// \param pile  receives the measurement (`PileTimer::addTotal`); null: it is lost
    void stop(PileTimer* pile);
    /// Makes the timer idle.
    void reset() { static_cast<zbTimerDat&>(*this) = zbTimerDat{}; }

    /// The performance counter, in ticks: `QueryPerformanceCounter` on Windows, the nanoseconds of `CLOCK_MONOTONIC`
    /// elsewhere.
    static std::int64_t Clock();
    /// Asks for the counter's ticks per second. They are read so when the library is loaded, and never again.
    /// \kept timers-03: the assertion that a missing counter raises (line 100) names `PileTimer::Clock()`
    /// \return what the system answered, also after that assertion
    static std::int64_t Init();

protected:
    /// Ticks per second.
    static std::int64_t _freq;
};

static_assert(sizeof(BaseTimer) == 32 && !std::is_polymorphic_v<BaseTimer>);

} // namespace ZOR_Basis

#endif
