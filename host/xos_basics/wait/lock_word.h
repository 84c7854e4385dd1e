/// \file
/// A lock in one word that any thread may give: free, held, or held while somebody perhaps sleeps.

#ifndef HOST_XOS_BASICS_WAIT_LOCK_WORD_H
#define HOST_XOS_BASICS_WAIT_LOCK_WORD_H

#include "host/xos_basics/wait/word_wait.h"

#include <atomic>
#include <cstdint>

namespace host {

constexpr std::uint32_t WORD_FREE = 0;
constexpr std::uint32_t WORD_HELD = 1;
constexpr std::uint32_t WORD_AWAITED = 2;

/// Waits a little in user space, then asleep.
void takeContended(std::atomic<std::uint32_t>& word);

inline void takeWord(std::atomic<std::uint32_t>& word) {
    std::uint32_t expected = WORD_FREE;
    if (!word.compare_exchange_strong(expected, WORD_HELD, std::memory_order_acquire, std::memory_order_relaxed)) {
        takeContended(word);
    }
}

inline void giveWord(std::atomic<std::uint32_t>& word) {
    if (word.exchange(WORD_FREE, std::memory_order_release) == WORD_AWAITED) { wakeOne(word); }
}

} // namespace host

#endif
