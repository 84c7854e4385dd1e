/// \file
/// Which of two threads' calls was the later one.
///
/// Most functions read a clock, once several threads call them. What is done to a semaphore costs less than that reading,
/// so these functions count time by events: a thread's time grows with each such call, a semaphore carries the giver's
/// time to the taker, and the common time passes it on where threads or tasks start and end, where any other function
/// with arguments is called by several threads, and where somebody asks for a last call. So only threads that agree on an order by means of
/// their own, between calls of nothing but these, leave the order of those calls open.

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

/// Makes every call that follows, in whatever thread, later than the thread's calls so far.
inline void publishTime(ThreadCalls const& mine) {
    std::uint64_t const time = mine.time.load(std::memory_order_relaxed);
    std::uint64_t common = commonTime.load(std::memory_order_relaxed);
    while (common < time && !commonTime.compare_exchange_weak(common, time, std::memory_order_release)) {}
}

/// Leaves the thread's time with a semaphore that it is about to give.
inline void leaveTime(ThreadCalls const& mine, std::atomic<std::uint64_t>& time) {
    time.store(mine.time.load(std::memory_order_relaxed), std::memory_order_relaxed);
}

/// Takes over the time of the semaphore's last giver.
inline void learnTime(ThreadCalls& mine, std::atomic<std::uint64_t> const& time) {
    std::uint64_t const left = time.load(std::memory_order_relaxed);
    if (left > mine.time.load(std::memory_order_relaxed)) { mine.time.store(left, std::memory_order_relaxed); }
}

/// The stamp of a call by a thread that is not known as its function's only caller.
/// \pre the function is not ordered by events
std::uint64_t stampOfSharedCall(Function function, ThreadCalls& caller);

[[gnu::always_inline]] inline std::uint64_t stampOfCall(Function function, ThreadCalls& caller) {
    if (isOrderedByEvents(function)) { return nextTime(caller); }
    bool const alone = soleCaller[indexOf(function)].load(std::memory_order_relaxed) == &caller;
    return alone ? 0 : stampOfSharedCall(function, caller);
}

} // namespace host

#endif
