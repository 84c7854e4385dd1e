/// \file
/// Decides which of two threads' calls came later.
///
/// Once several threads call a function, it normally reads a clock. A semaphore operation costs less than that reading,
/// so the semaphore functions use a logical clock instead: each such call advances the thread's time, and a semaphore
/// carries the giver's time to the taker. The common time passes it on when a thread or task starts or ends, when
/// several threads call another function with arguments, and when a last call is queried. The order of semaphore calls
/// is therefore undefined only if threads order them by other means and call nothing else in between.

#ifndef HOST_XOS_BASICS_CONTROL_CALL_ORDER_H
#define HOST_XOS_BASICS_CONTROL_CALL_ORDER_H

#include "host/xos_basics/control/call_record.h"

#include <algorithm>
#include <atomic>
#include <cstdint>

namespace host {

extern constinit std::atomic<std::uint64_t> commonTime;

constexpr bool isOrderedByEvents(Function function) {
    return function == Function::xos_SemTake || function == Function::xos_SemGive ||
           function == Function::xos_SemMCreate || function == Function::xos_SemBCreate ||
           function == Function::xos_SemDestroy;
}

inline std::uint64_t nextTime(ThreadCalls& mine) {
    std::uint64_t const time =
        std::max(mine.time.load(std::memory_order_relaxed), commonTime.load(std::memory_order_acquire)) + 1;
    mine.time.store(time, std::memory_order_relaxed);
    return time;
}

/// Makes every following call, in any thread, later than this thread's calls so far.
inline void publishTime(ThreadCalls const& mine) {
    std::uint64_t const time = mine.time.load(std::memory_order_relaxed);
    std::uint64_t common = commonTime.load(std::memory_order_relaxed);
    while (common < time && !commonTime.compare_exchange_weak(common, time, std::memory_order_release)) {}
}

/// Stores the thread's time in a semaphore that it is about to give.
inline void leaveTime(ThreadCalls const& mine, std::atomic<std::uint64_t>& time) {
    time.store(mine.time.load(std::memory_order_relaxed), std::memory_order_relaxed);
}

/// Adopts the time of the semaphore's last giver, if that is later.
inline void learnTime(ThreadCalls& mine, std::atomic<std::uint64_t> const& time) {
    std::uint64_t const left = time.load(std::memory_order_relaxed);
    if (left > mine.time.load(std::memory_order_relaxed)) mine.time.store(left, std::memory_order_relaxed);
}

/// Returns the stamp of a call by a thread that is not known to be its function's only caller.
/// \pre the function is not ordered by events
std::uint64_t stampOfSharedCall(Function function, ThreadCalls& caller);

[[gnu::always_inline]] inline std::uint64_t stampOfCall(Function function, ThreadCalls& caller) {
    if (isOrderedByEvents(function)) return nextTime(caller);
    bool const alone = soleCaller[indexOf(function)].load(std::memory_order_relaxed) == &caller;
    return alone ? 0 : stampOfSharedCall(function, caller);
}

} // namespace host

#endif
