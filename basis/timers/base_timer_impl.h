/// \file
/// The check behind `BaseTimer::Init`, apart from the system's answer.

#ifndef BASIS_TIMERS_BASE_TIMER_IMPL_H
#define BASIS_TIMERS_BASE_TIMER_IMPL_H

#include "basis/ground/clock.h"

namespace ZOR_Basis {

/// The ticks per second of an answer, after a complaint if they are not known.
std::int64_t checkedFrequency(PerformanceCounter::Frequency const& answer);

} // namespace ZOR_Basis

#endif
