#include "zor_basis/timers/pile_timer_auto.h"

#include "basis/timers/driven_pile.h"

namespace ZOR_Basis {

PileTimerAuto::PileTimerAuto(PileTimer* pile, TimerMgr* manager, bool startNow, bool beginSuspended)
    : pile_(drivenPile(pile, manager)) {
    if (startNow) start(beginSuspended);
}

void PileTimerAuto::start(bool beginSuspended) { PileTimer::start(pile_, beginSuspended); }
void PileTimerAuto::stop() { PileTimer::stop(pile_); }
void PileTimerAuto::suspend() { PileTimer::suspend(pile_); }
void PileTimerAuto::resume() { PileTimer::resume(pile_); }

} // namespace ZOR_Basis
