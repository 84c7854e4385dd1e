/// \file
/// A lock that any thread may give, in two words: one says whether it is held, the other whether a thread sleeps at it.
///
/// A giver frees the first word and then looks at the second; a sleeper sets the second and then looks at the first.
/// One of them sees what the other did, provided that neither looks before it writes. The sleeper takes care of both
/// sides by a barrier for the whole process. So giving needs no locked instruction, which would cost as much as all the
/// rest.

#ifndef HOST_XOS_BASICS_WAIT_LOCK_WORD_H
#define HOST_XOS_BASICS_WAIT_LOCK_WORD_H

#include "host/xos_basics/wait/process_barrier.h"

#include <atomic>
#include <cstdint>

namespace host {

constexpr std::uint32_t WORD_FREE = 0;
constexpr std::uint32_t WORD_HELD = 1;

struct LockWord {
    std::atomic<std::uint32_t> held{WORD_FREE};
    std::atomic<std::uint32_t> awaited{0};
};

/// Waits a little in user space, then asleep.
void takeContended(LockWord& lock);

/// Wakes one of the threads that sleep at the lock.
void wakeSleeper(LockWord& lock);

inline bool isTakenAtOnce(LockWord& lock) {
    std::uint32_t expected = WORD_FREE;
    return lock.held.compare_exchange_strong(expected, WORD_HELD, std::memory_order_acquire, std::memory_order_relaxed);
}

inline void takeWord(LockWord& lock) {
    if (!isTakenAtOnce(lock)) takeContended(lock);
}

/// Touches the lock once more after it is free.
inline void giveWord(LockWord& lock) {
    if (hasProcessBarrier) {
        lock.held.store(WORD_FREE, std::memory_order_release);
        std::atomic_signal_fence(std::memory_order_seq_cst);
    } else {
        lock.held.exchange(WORD_FREE, std::memory_order_seq_cst);
    }
    if (lock.awaited.load(std::memory_order_seq_cst) != 0) wakeSleeper(lock);
}

} // namespace host

#endif
