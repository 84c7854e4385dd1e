/// \file
/// The performance counter: clock_win.cpp, clock_posix.cpp.

#ifndef BASIS_GROUND_CLOCK_H
#define BASIS_GROUND_CLOCK_H

#include <cstdint>

namespace ZOR_Basis::PerformanceCounter {

struct Frequency {
    bool known;
    std::int64_t ticksPerSecond;
};

/// In ticks.
std::int64_t now() noexcept;
Frequency frequency() noexcept;

} // namespace ZOR_Basis::PerformanceCounter

#endif
