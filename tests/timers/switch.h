/// \file
/// A manager without timers, for tests of objects that only ask whether it is active.

#ifndef TESTS_TIMERS_SWITCH_H
#define TESTS_TIMERS_SWITCH_H

#include <zor_basis/timers.h>

class Switch : public ZOR_Basis::TimerMgr {
public:
    explicit Switch(bool on) { setActive(on); }
    ZOR_Basis::PileTimer* createTimer(char const*, std::uint64_t, bool) override { return nullptr; }
    ZOR_Basis::PileTimer* getTimer(std::uint64_t) override { return nullptr; }
    void resetTimers(bool) override {}
};

#endif
