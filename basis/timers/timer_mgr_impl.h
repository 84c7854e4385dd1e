/// \file
/// The one kind of timer manager.

#ifndef BASIS_TIMERS_TIMER_MGR_IMPL_H
#define BASIS_TIMERS_TIMER_MGR_IMPL_H

#include "basis/platform/xos_basics.h"
#include "basis/timers/timer_slots.h"
#include "zor_basis/text/heap_str.h"
#include "zor_basis/timers/timer_mgr.h"

namespace ZOR_Basis {

class TimerMgrImpl final : public TimerMgr {
public:
    TimerMgrImpl(char const* name, std::uint64_t maxId);
    /// Deletes the timers that it still holds.
    ~TimerMgrImpl() override;

    HeapStr const& name() const { return name_; }

    PileTimer* createTimer(char const* name, std::uint64_t id, bool forThreads) override;
    PileTimer* getTimer(std::uint64_t id) override;
    void resetTimers(bool print) override;

private:
    void add(PileTimer* timer, std::uint64_t id);
    template <class Act>
    void forEach(Act act);

    TimerSlots timers_{8};
    xos_Sem const lock_;
    HeapStr name_;
};

} // namespace ZOR_Basis

#endif
