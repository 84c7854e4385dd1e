#include "basis/ground/choices.h"
#include "zor_basis/flat.h"
#include "zor_basis/timers/base_timer.h"
#include "zor_basis/timers/pile_timer.h"
#include "zor_basis/timers/timer_mgr.h"

using ZOR_Basis::BaseTimer;
using ZOR_Basis::PileTimer;
using ZOR_Basis::TimerMgr;

namespace {

/// Does something to a caller's record, which was never made as a `BaseTimer`.
template <class Act>
void asTimer(zbTimerDat& measurement, Act act) {
    BaseTimer timer;
    static_cast<zbTimerDat&>(timer) = measurement;
    act(timer);
    measurement = timer;
}

} // namespace

void zbTimerBaseStart(zbTimerDat* measurement, int suspended) {
    // kept flat-01: a caller's record may hold anything before its first start.
    if (measurement != nullptr) *measurement = BaseTimer(ZOR_Basis::STARTED, suspended != 0);
}

void zbTimerBaseStop(zbTimerDat* measurement, zbPileTimer* pile) {
    // kept flat-02: a caller that has no pile yet loses nothing.
    if (measurement == nullptr || pile == nullptr || measurement->start <= 0) return;
    asTimer(*measurement, [pile](BaseTimer& timer) { timer.stop(pile); });
}

void zbTimerBaseSuspend(zbTimerDat* measurement) {
    if (measurement != nullptr) asTimer(*measurement, [](BaseTimer& timer) { timer.suspend(); });
}

void zbTimerBaseResume(zbTimerDat* measurement) {
    if (measurement != nullptr) asTimer(*measurement, [](BaseTimer& timer) { timer.resume(); });
}

void zbTimerStart(zbPileTimer* timer) { PileTimer::start(timer, ZOR_Basis::NOT_SUSPENDED); }
void zbTimerStop(zbPileTimer* timer) { PileTimer::stop(timer); }
void zbTimerSuspend(zbPileTimer* timer) { PileTimer::suspend(timer); }
void zbTimerResume(zbPileTimer* timer) { PileTimer::resume(timer); }

zbTimerMgr* zbTimerMgrNew(char const* name, uint64_t maxId) { return TimerMgr::New(name, maxId); }
zbTimerMgr* zbTimerMgrGetMgr(char const* name) { return TimerMgr::Get(name); }

zbPileTimer* zbTimerMgrCreate(zbTimerMgr* manager, char const* name, uint64_t id) {
    return TimerMgr::create(manager, name, id, ZOR_Basis::FOR_ONE_THREAD);
}
zbPileTimer* zbTimerMgrCreateMT(zbTimerMgr* manager, char const* name, uint64_t id) {
    return TimerMgr::create(manager, name, id, ZOR_Basis::FOR_THREADS);
}
zbPileTimer* zbTimerMgrGet(zbTimerMgr* manager, uint64_t id) { return TimerMgr::get(manager, id); }

void zbTimerMgrSetActive(zbTimerMgr* manager, int active) {
    if (manager != nullptr) manager->setActive(active != 0);
}
void zbTimerMgrReset(zbTimerMgr* manager, int print) { TimerMgr::reset(manager, print != 0); }

void zbTimerMgrStart(zbTimerMgr* manager, zbPileTimer* timer) {
    if (manager != nullptr) manager->start(timer);
}
void zbTimerMgrStop(zbTimerMgr* manager, zbPileTimer* timer) {
    if (manager != nullptr) manager->stop(timer);
}
void zbTimerMgrSuspend(zbTimerMgr* manager, zbPileTimer* timer) {
    if (manager != nullptr) manager->suspend(timer);
}
void zbTimerMgrResume(zbTimerMgr* manager, zbPileTimer* timer) {
    if (manager != nullptr) manager->resume(timer);
}
