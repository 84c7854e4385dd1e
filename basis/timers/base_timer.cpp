#include "zor_basis/timers/base_timer.h"

#include "basis/timers/base_timer_impl.h"
#include "basis/timers/complaint.h"

namespace ZOR_Basis {

std::int64_t BaseTimer::_freq = BaseTimer::Init();

std::int64_t checkedFrequency(PerformanceCounter::Frequency const& answer) {
    // kept timers-03: the text is as it was when the counter belonged to `PileTimer`.
    if (!answer.known) complain(100, "PileTimer::Clock() - clock API not supported!");
    return answer.ticksPerSecond;
}

BaseTimer::BaseTimer(bool startNow, bool beginSuspended) : zbTimerDat{} {
    if (startNow) start(beginSuspended);
}

void BaseTimer::start(bool beginSuspended) {
    if (zbTimerDat::start == 0) zbTimerDat::start = PerformanceCounter::now();
    if (beginSuspended) suspend();
}

void BaseTimer::suspend() {
    // kept timers-02: whether the timer runs is not asked.
    if (suspendStart == 0) suspendStart = PerformanceCounter::now();
}

void BaseTimer::resume() {
    if (suspendStart == 0) return;
    zbTimerDat::suspended += PerformanceCounter::now() - suspendStart;
    suspendStart = 0;
}

std::int64_t BaseTimer::Clock() { return PerformanceCounter::now(); }
std::int64_t BaseTimer::Init() { return checkedFrequency(PerformanceCounter::frequency()); }

} // namespace ZOR_Basis
