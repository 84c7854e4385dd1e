#include "host/xos_basics/wait/lock_word.h"

#include "host/xos_basics/wait/pause.h"
#include "host/xos_basics/wait/word_wait.h"

namespace host {

namespace {

/// The longest rest between two looks, in pauses; the rests before it double. Each look takes the cache line away from
/// the holder, so they become rare soon. All together last about ten microseconds, as sleeping and waking do.
constexpr int LONGEST_REST = 64;
constexpr int LOOKS_AT_LONGEST = 4;

bool isTakenNow(LockWord& lock) {
    return lock.held.load(std::memory_order_relaxed) == WORD_FREE && isTakenAtOnce(lock);
}

bool isTakenAfterRest(LockWord& lock, int pauses) {
    for (int i = 0; i < pauses; ++i) { pauseBriefly(); }
    return isTakenNow(lock);
}

bool isTakenAwake(LockWord& lock) {
    for (int rest = 1; rest < LONGEST_REST; rest *= 2) {
        if (isTakenAfterRest(lock, rest)) return true;
    }
    for (int i = 0; i < LOOKS_AT_LONGEST; ++i) {
        if (isTakenAfterRest(lock, LONGEST_REST)) return true;
    }
    return false;
}

/// Ensures that every thread that gives the lock from now on sees that it is awaited.
void announceSleeper(LockWord& lock) {
    lock.awaited.exchange(1, std::memory_order_seq_cst);
    if (hasProcessBarrier) passProcessBarrier();
}

} // namespace

void takeContended(LockWord& lock) {
    if (isTakenAwake(lock)) return;
    // A thread that has slept leaves the lock awaited, because others may still be asleep; its own give wakes the next
    // one.
    for (;;) {
        announceSleeper(lock);
        std::uint32_t expected = WORD_FREE;
        if (lock.held.compare_exchange_strong(expected, WORD_HELD, std::memory_order_seq_cst)) return;
        waitWhile(lock.awaited, 1);
    }
}

void wakeSleeper(LockWord& lock) {
    if (lock.awaited.exchange(0, std::memory_order_relaxed) != 0) wakeOne(lock.awaited);
}

} // namespace host
