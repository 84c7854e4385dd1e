/// \file
/// The registry of timer managers: one object, made at first use and never destroyed.

#ifndef BASIS_TIMERS_TIMER_MGR_MGR_H
#define BASIS_TIMERS_TIMER_MGR_MGR_H

#include "basis/sync/held_semaphore.h"
#include "zor_basis/containers/ptr_array.h"
#include "zor_basis/files/f_path.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class TimerMgrImpl;

/// \thread thread-safe
class TimerMgrMgr {
public:
    /// Finds the report folder and makes it, if it can.
    TimerMgrMgr();
    TimerMgrMgr(TimerMgrMgr const&) = delete;
    TimerMgrMgr& operator=(TimerMgrMgr const&) = delete;

    void add(TimerMgrImpl* manager);
    /// The first manager, in creation order, for which `fits` is true; null if there is none.
    template <class Fits>
    TimerMgrImpl* find(Fits fits) const {
        HeldSemaphore const held(lock_);
        for (std::uint64_t i = 0; i < managers_.size(); ++i) {
            if (fits(*managers_[i])) return managers_[i];
        }
        return nullptr;
    }

    /// Keeps the first number other than 0.
    void setRip(std::int32_t rip);
    std::int32_t rip() const { return rip_.load(std::memory_order_relaxed); }
    /// The report folder.
    FPath const& dir() const { return dir_; }

private:
    PtrArray<TimerMgrImpl> managers_{8};
    xos_Sem const lock_;
    FPath dir_;
    std::atomic<std::int32_t> rip_{0};
};

} // namespace ZOR_Basis

#endif
