#include "zor_basis/timers/base_timer_auto.h"

#include "basis/timers/driven_pile.h"

namespace ZOR_Basis {

BaseTimerAuto::BaseTimerAuto(PileTimer* pile, TimerMgr* manager, bool startNow, bool beginSuspended)
    : pile_(drivenPile(pile, manager)) {
    if (startNow) start(beginSuspended);
}

void BaseTimerAuto::start(bool beginSuspended) {
    if (pile_ != nullptr) timer_.start(beginSuspended);
}
void BaseTimerAuto::stop() {
    if (pile_ != nullptr) timer_.stop(pile_);
}
void BaseTimerAuto::suspend() {
    if (pile_ != nullptr) timer_.suspend();
}
void BaseTimerAuto::resume() {
    if (pile_ != nullptr) timer_.resume();
}

} // namespace ZOR_Basis
