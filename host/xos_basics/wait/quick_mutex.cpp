#include "host/xos_basics/wait/quick_mutex.h"

#include "host/xos_basics/wait/pause.h"
#include "host/xos_basics/wait/word_wait.h"

namespace host {

namespace {

/// How often a holder is given the time to finish before the waiting thread sleeps: about a microsecond in all.
constexpr int SPINS = 40;

} // namespace

void QuickMutex::lockContended() {
    for (int i = 0; i < SPINS; ++i) {
        std::uint32_t const seen = _state.load(std::memory_order_relaxed);
        if (seen == AWAITED) { break; }
        if (seen == FREE && try_lock()) { return; }
        pauseBriefly();
    }
    while (_state.exchange(AWAITED, std::memory_order_acquire) != FREE) { waitWhile(_state, AWAITED); }
}

void QuickMutex::wakeWaiter() { wakeOne(_state); }

} // namespace host
