/// \file
/// `PileTimerAuto`: measures a scope with the pile's own measurement. Only one scope at a time may do so for a pile;
/// others use `BaseTimerAuto`.
///
/// \thread one thread at a time, together with the pile

#ifndef ZOR_BASIS_TIMERS_PILE_TIMER_AUTO_H
#define ZOR_BASIS_TIMERS_PILE_TIMER_AUTO_H

#include "zor_basis/export.h"
#include "zor_basis/text/pointer_guard.h"

namespace ZOR_Basis {

class PileTimer;
class TimerMgr;

class ZB_API PileTimerAuto : public detail::NotDeletable<PileTimerAuto> {
public:
    /// Inert: without a pile, it never does anything.
    PileTimerAuto() = default;
    /// \param pile  is driven by this object; null makes it inert
    /// \param manager  makes the object inert if it is not null and inactive; only the constructor asks
    /// \param startNow  calls `PileTimer::start(beginSuspended)`
    PileTimerAuto(PileTimer* pile, TimerMgr* manager, bool startNow, bool beginSuspended);
    PileTimerAuto(PileTimerAuto const&) = delete;
    PileTimerAuto& operator=(PileTimerAuto const&) = delete;
    /// Calls `stop`; a pile that was stopped before reports misuse.
    ~PileTimerAuto() { stop(); }

    /// The same as in `PileTimer`; no effect if inert.
    void start(bool beginSuspended);
    void stop();
    void suspend();
    void resume();

    /// The pile; null if inert.
    operator PileTimer*() { return pile_; }
    PileTimer* operator->() { return pile_; }

private:
    PileTimer* pile_ = nullptr;
};

} // namespace ZOR_Basis

#endif
