#include "host/xos_basics/wait/lock_word.h"

#include "host/xos_basics/wait/pause.h"

namespace host {

namespace {

/// The longest rest between two looks, in pauses; the rests before it double. Each look takes the cache line away from the
/// holder, so they become rare soon. All together last about ten microseconds, as sleeping and waking do.
constexpr int LONGEST_REST = 64;
constexpr int LOOKS_AT_LONGEST = 4;

bool isTakenNow(std::atomic<std::uint32_t>& word) {
    std::uint32_t seen = word.load(std::memory_order_relaxed);
    return seen == WORD_FREE &&
           word.compare_exchange_strong(seen, WORD_HELD, std::memory_order_acquire, std::memory_order_relaxed);
}

bool isTakenAfterRest(std::atomic<std::uint32_t>& word, int pauses) {
    for (int i = 0; i < pauses; ++i) { pauseBriefly(); }
    return isTakenNow(word);
}

bool isTakenAwake(std::atomic<std::uint32_t>& word) {
    for (int rest = 1; rest < LONGEST_REST; rest *= 2) {
        if (isTakenAfterRest(word, rest)) { return true; }
    }
    for (int i = 0; i < LOOKS_AT_LONGEST; ++i) {
        if (isTakenAfterRest(word, LONGEST_REST)) { return true; }
    }
    return false;
}

} // namespace

void takeContended(std::atomic<std::uint32_t>& word) {
    if (isTakenAwake(word)) { return; }
    while (word.exchange(WORD_AWAITED, std::memory_order_acquire) != WORD_FREE) { waitWhile(word, WORD_AWAITED); }
}

} // namespace host
