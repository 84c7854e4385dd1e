/// \file
/// The check behind `BaseTimer::Init`, apart from the system's answer.

#ifndef BASIS_TIMERS_BASE_TIMER_IMPL_H
#define BASIS_TIMERS_BASE_TIMER_IMPL_H

#include "basis/ground/clock.h"

namespace ZOR_Basis {

/// Extracts the ticks per second from an answer; complains if they are unknown.
std::int64_t checkedFrequency(PerformanceCounter::Frequency const& answer);

} // namespace ZOR_Basis

#endif
