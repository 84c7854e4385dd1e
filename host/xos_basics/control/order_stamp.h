/// \file
/// A number that grows with time over all threads: if one call ended before another began, its stamp is smaller.

#ifndef HOST_XOS_BASICS_CONTROL_ORDER_STAMP_H
#define HOST_XOS_BASICS_CONTROL_ORDER_STAMP_H

#include <cstdint>

#if defined(_MSC_VER)
#include <intrin.h>
#elif defined(__x86_64__)
#include <x86intrin.h>
#else
#include <chrono>
#endif

namespace host {

inline std::uint64_t orderStamp() {
#if defined(_MSC_VER) || defined(__x86_64__)
    // The fence keeps the counter from being read before the loads by which this thread learnt of the earlier call.
    _mm_lfence();
    return __rdtsc();
#else
    return static_cast<std::uint64_t>(std::chrono::steady_clock::now().time_since_epoch().count());
#endif
}

} // namespace host

#endif
