/// \file
/// `PileTimerMT`: a pile that many threads may feed concurrently. Managers make it (`TimerMgr::create`).
///
/// \thread each thread runs its own `BaseTimer` or `BaseTimerAuto` and stops it into the shared pile. Only adding to
///     the pile is locked; the pile's own measurement belongs to one thread, as with any `PileTimer`

#ifndef ZOR_BASIS_TIMERS_PILE_TIMER_MT_H
#define ZOR_BASIS_TIMERS_PILE_TIMER_MT_H

#include "zor_basis/timers/pile_timer.h"

namespace ZOR_Basis {

class ZB_API PileTimerMT : public PileTimer {
public:
    /// Constructs a `PileTimer` with a mutex of the platform layer.
    /// \error if the mutex cannot be made, the pile is not locked
    PileTimerMT(char const* name, bool checks);
    PileTimerMT(PileTimerMT const&) = delete;
    PileTimerMT& operator=(PileTimerMT const&) = delete;
    ~PileTimerMT() override;

protected:
    void lock() override;
    void unlock() override;

private:
    std::uint64_t semaphore_;
};

} // namespace ZOR_Basis

#endif
