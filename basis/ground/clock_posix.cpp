// The sibling is clock_win.cpp.
#include "basis/ground/clock.h"

#include <ctime>

namespace ZOR_Basis::PerformanceCounter {
namespace {

constexpr std::int64_t NANOSECONDS = 1'000'000'000;

} // namespace

std::int64_t now() noexcept {
    timespec time;
    clock_gettime(CLOCK_MONOTONIC, &time);
    return time.tv_sec * NANOSECONDS + time.tv_nsec;
}

Frequency frequency() noexcept {
    timespec time;
    return {clock_gettime(CLOCK_MONOTONIC, &time) == 0, NANOSECONDS};
}

} // namespace ZOR_Basis::PerformanceCounter
