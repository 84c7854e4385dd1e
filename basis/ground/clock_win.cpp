// The sibling is clock_posix.cpp.
#include "basis/ground/clock.h"

#include "basis/platform/windows_api_win.h"

namespace ZOR_Basis::PerformanceCounter {

std::int64_t now() noexcept {
    LARGE_INTEGER ticks;
    QueryPerformanceCounter(&ticks);
    return ticks.QuadPart;
}

Frequency frequency() noexcept {
    LARGE_INTEGER ticks = {};
    bool const known = QueryPerformanceFrequency(&ticks) != 0;
    return {known, ticks.QuadPart};
}

} // namespace ZOR_Basis::PerformanceCounter
