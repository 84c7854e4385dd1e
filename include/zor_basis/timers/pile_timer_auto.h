/// \file
/// `PileTimerAuto`: measures a scope by the pile's own measurement. Only one scope at a time drives a pile so; others use
/// `BaseTimerAuto`.
///
/// \thread  one thread at a time, together with the pile

#ifndef ZOR_BASIS_TIMERS_PILE_TIMER_AUTO_H
#define ZOR_BASIS_TIMERS_PILE_TIMER_AUTO_H

#include "zor_basis/export.h"
#include "zor_basis/text/pointer_guard.h"

namespace ZOR_Basis {

class PileTimer;
class TimerMgr;

class ZB_API PileTimerAuto : public detail::NotDeletable<PileTimerAuto> {
public:
    /// Inert: without a pile, it does nothing ever.
    PileTimerAuto() = default;
    /// \param pile  null: inert
    /// \param manager  inert if it is not null and inactive; asked here and never again
    /// \param startNow  `PileTimer::start(beginSuspended)`
    PileTimerAuto(PileTimer* pile, TimerMgr* manager, bool startNow, bool beginSuspended);
    PileTimerAuto(PileTimerAuto const&) = delete;
    PileTimerAuto& operator=(PileTimerAuto const&) = delete;
    /// `stop`, with the complaint of a pile that was stopped before.
    ~PileTimerAuto() { stop(); }

    /// As `PileTimer` has them, unless inert.
    void start(bool beginSuspended);
    void stop();
    void suspend();
    void resume();

    /// The pile; null when inert.
    operator PileTimer*() { return pile_; }
    PileTimer* operator->() { return pile_; }

private:
    PileTimer* pile_ = nullptr;
};

} // namespace ZOR_Basis

#endif
