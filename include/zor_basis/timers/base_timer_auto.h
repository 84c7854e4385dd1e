/// \file
/// `BaseTimerAuto`: measures a scope by a measurement of its own, so that nested and concurrent scopes may feed one pile.
///
/// \thread  one thread at a time; the pile is shared as its class allows

#ifndef ZOR_BASIS_TIMERS_BASE_TIMER_AUTO_H
#define ZOR_BASIS_TIMERS_BASE_TIMER_AUTO_H

#include "zor_basis/export.h"
#include "zor_basis/text/pointer_guard.h"
#include "zor_basis/timers/base_timer.h"

namespace ZOR_Basis {

class TimerMgr;

class ZB_API BaseTimerAuto : public detail::NotDeletable<BaseTimerAuto> {
public:
    /// Inert: without a pile, it does nothing ever.
    BaseTimerAuto() = default;
    /// \param pile  receives the measurement; null: inert
    /// \param manager  inert if it is not null and inactive
    /// \param startNow, beginSuspended  as for `BaseTimer`
    /// \kept timers-12: the manager is asked here and never again: what it switches off stays off
    BaseTimerAuto(PileTimer* pile, TimerMgr* manager, bool startNow, bool beginSuspended);
    BaseTimerAuto(BaseTimerAuto const&) = delete;
    /// Takes the pile and a copy of the measurement; its own measurement is lost.
    BaseTimerAuto& operator=(BaseTimerAuto const&) = default;
    /// `stop`.
    ~BaseTimerAuto() { stop(); }

    /// As `BaseTimer` has them, unless inert.
    void start(bool beginSuspended);
    void stop();
    void suspend();
    void resume();

    /// The pile; null when inert.
    operator PileTimer*() { return pile_; }
    PileTimer* operator->() { return pile_; }

private:
    PileTimer* pile_ = nullptr;
    BaseTimer timer_;
};

} // namespace ZOR_Basis

#endif
