/// \file
/// `BaseTimerAuto`: measures a scope with its own measurement, so nested and concurrent scopes may share one pile.
///
///     BaseTimerAuto timer(pile, manager, true, false); // stops at the end of the scope
///
/// \thread one thread at a time; the pile may be shared as its class allows

#ifndef ZOR_BASIS_TIMERS_BASE_TIMER_AUTO_H
#define ZOR_BASIS_TIMERS_BASE_TIMER_AUTO_H

#include "zor_basis/export.h"
#include "zor_basis/text/pointer_guard.h"
#include "zor_basis/timers/base_timer.h"

namespace ZOR_Basis {

class TimerMgr;

class ZB_API BaseTimerAuto : public detail::NotDeletable<BaseTimerAuto> {
public:
    /// Inert: without a pile, it never does anything.
    BaseTimerAuto() = default;
    /// \param pile  receives the measurement; null: inert
    /// \param manager  makes the timer inert if it is not null and inactive
    /// \param startNow, beginSuspended  have the same meaning as for `BaseTimer`
    /// \kept timers-12: only the constructor asks the manager: a timer that is inert then stays inert
    BaseTimerAuto(PileTimer* pile, TimerMgr* manager, bool startNow, bool beginSuspended);
    BaseTimerAuto(BaseTimerAuto const&) = delete;
    /// Copies the pile and the measurement; its own measurement is discarded.
    BaseTimerAuto& operator=(BaseTimerAuto const&) = default;
    /// Calls `stop`.
    ~BaseTimerAuto() { stop(); }

    /// The same as in `BaseTimer`; no effect if inert.
    void start(bool beginSuspended);
    void stop();
    void suspend();
    void resume();

    /// The pile; null if inert.
    operator PileTimer*() { return pile_; }
    PileTimer* operator->() { return pile_; }

private:
    PileTimer* pile_ = nullptr;
    BaseTimer timer_;
};

} // namespace ZOR_Basis

#endif
