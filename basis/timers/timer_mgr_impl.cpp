#include "basis/timers/timer_mgr_impl.h"

#include "basis/ground/choices.h"
#include "basis/sync/held_semaphore.h"
#include "basis/timers/complaint.h"
#include "basis/timers/report_file.h"
#include "basis/timers/timer_mgr_mgr.h"
#include "zor_basis/timers/pile_timer.h"
#include "zor_basis/timers/pile_timer_mt.h"

namespace ZOR_Basis {
namespace {

/// Lack of memory ends the program.
PileTimer* makeTimer(char const* name, bool forThreads) noexcept {
    if (forThreads) return new PileTimerMT(name, WITH_CHECKS);
    return new PileTimer(name, WITH_CHECKS);
}

} // namespace

TimerMgrImpl::TimerMgrImpl(char const* name, std::uint64_t maxId) : lock_(xos_SemMCreate()), name_(name) {
    if (maxId != 0) timers_.set(nullptr, maxId);
}

TimerMgrImpl::~TimerMgrImpl() {
    forEach([](PileTimer& timer) { delete &timer; });
    xos_SemDestroy(lock_);
}

template <class Act>
void TimerMgrImpl::forEach(Act act) {
    for (std::uint64_t id = 0; id < timers_.size(); ++id) {
        if (PileTimer* const timer = timers_[id]) act(*timer);
    }
}

PileTimer* TimerMgrImpl::createTimer(char const* name, std::uint64_t id, bool forThreads) {
    PileTimer* const timer = makeTimer(name, forThreads);
    add(timer, id);
    return timer;
}

void TimerMgrImpl::add(PileTimer* timer, std::uint64_t id) {
    HeldSemaphore const held(lock_);
    if (id == 0) {
        timer->setId(timers_.insertBack(timer));
        return;
    }
    if (timers_.find(id) != nullptr) complain(356, "TimerMgr::add() - already registered!");
    // kept timers-09: a holder of the timer that was here may go on using it.
    timer->setId(id);
    timers_.put(timer, id);
}

PileTimer* TimerMgrImpl::getTimer(std::uint64_t id) { return timers_.find(id); }

void TimerMgrImpl::resetTimers(bool print) {
    HeldSemaphore const held(lock_);
    // kept timers-10: timers that cannot be written are cleared, too.
    if (!print) return forEach([](PileTimer& timer) { timer.reset(); });
    TimerMgrMgr const& registry = *TimerMgr::Mgr();
    ReportFile report(registry.dir(), name_, registry.rip());
    forEach([&report](PileTimer& timer) {
        report.write(timer);
        timer.reset();
    });
}

} // namespace ZOR_Basis
