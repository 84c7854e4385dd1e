#include "zor_basis/timers/timer_mgr.h"

#include "basis/ground/choices.h"
#include "basis/timers/timer_mgr_impl.h"
#include "basis/timers/timer_mgr_mgr.h"
#include "zor_basis/timers/pile_timer.h"

#include <cstring>

namespace ZOR_Basis {
namespace {

/// Lack of memory ends the program, here and below.
TimerMgrImpl* makeManager(char const* name, std::uint64_t maxId) noexcept { return new TimerMgrImpl(name, maxId); }
TimerMgrMgr* makeRegistry() noexcept { return new TimerMgrMgr; }

} // namespace

TimerMgr::~TimerMgr() = default;

TimerMgrMgr* TimerMgr::Mgr() {
    static TimerMgrMgr* const only = makeRegistry();
    return only;
}

TimerMgr* TimerMgr::New(char const* name, std::uint64_t maxId) {
    TimerMgrImpl* const manager = makeManager(name, maxId);
    Mgr()->add(manager);
    return manager;
}

TimerMgr* TimerMgr::Get(char const* name) {
    TimerMgrMgr const& registry = *Mgr();
    if (name == nullptr) return nullptr;
    return registry.find(
        [name](TimerMgrImpl const& manager) { return std::strcmp(manager.name().c_str(), name) == 0; });
}

void TimerMgr::setRip(int rip) { Mgr()->setRip(rip); }

PileTimer* TimerMgr::create(TimerMgr* manager, char const* name, std::uint64_t id, bool forThreads) {
    return manager != nullptr ? manager->createTimer(name, id, forThreads) : nullptr;
}
PileTimer* TimerMgr::get(TimerMgr* manager, std::uint64_t id) {
    return manager != nullptr ? manager->getTimer(id) : nullptr;
}

void TimerMgr::startSlot(std::uint64_t id) {
    if (PileTimer* const timer = activeSlot(id)) timer->start(NOT_SUSPENDED);
}
void TimerMgr::stopSlot(std::uint64_t id) {
    if (PileTimer* const timer = activeSlot(id)) timer->stop();
}
void TimerMgr::suspendSlot(std::uint64_t id) {
    if (PileTimer* const timer = activeSlot(id)) timer->suspend();
}
void TimerMgr::resumeSlot(std::uint64_t id) {
    if (PileTimer* const timer = activeSlot(id)) timer->resume();
}

void TimerMgr::start(PileTimer* timer) {
    if (active()) PileTimer::start(timer, NOT_SUSPENDED);
}
void TimerMgr::stop(PileTimer* timer) {
    if (active()) PileTimer::stop(timer);
}
void TimerMgr::suspend(PileTimer* timer) {
    if (active()) PileTimer::suspend(timer);
}
void TimerMgr::resume(PileTimer* timer) {
    if (active()) PileTimer::resume(timer);
}

void TimerMgr::start(TimerMgr* manager, std::uint64_t id) {
    if (manager != nullptr) manager->start(id);
}
void TimerMgr::start(TimerMgr* manager, PileTimer* timer) {
    if (manager != nullptr) manager->start(timer);
}
void TimerMgr::stop(TimerMgr* manager, std::uint64_t id) {
    if (manager != nullptr) manager->stop(id);
}
void TimerMgr::stop(TimerMgr* manager, PileTimer* timer) {
    if (manager != nullptr) manager->stop(timer);
}
void TimerMgr::suspend(TimerMgr* manager, std::uint64_t id) {
    if (manager != nullptr) manager->suspend(id);
}
void TimerMgr::suspend(TimerMgr* manager, PileTimer* timer) {
    if (manager != nullptr) manager->suspend(timer);
}
void TimerMgr::resume(TimerMgr* manager, std::uint64_t id) {
    if (manager != nullptr) manager->resume(id);
}
void TimerMgr::resume(TimerMgr* manager, PileTimer* timer) {
    if (manager != nullptr) manager->resume(timer);
}

void TimerMgr::reset(bool print) {
    if (active()) resetTimers(print);
}
void TimerMgr::reset(TimerMgr* manager, bool print) {
    if (manager != nullptr) manager->reset(print);
}

} // namespace ZOR_Basis
