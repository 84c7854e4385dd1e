/// \file
/// The host's own lock: four bytes, initialised before any code runs and never destroyed, uncontended in user space.
/// Works with `std::lock_guard`.

#ifndef HOST_XOS_BASICS_WAIT_QUICK_MUTEX_H
#define HOST_XOS_BASICS_WAIT_QUICK_MUTEX_H

#include <atomic>
#include <cstdint>

namespace host {

class QuickMutex {
public:
    constexpr QuickMutex() = default;
    QuickMutex(QuickMutex const&) = delete;
    QuickMutex& operator=(QuickMutex const&) = delete;

    void lock() {
        if (!try_lock()) { lockContended(); }
    }

    bool try_lock() {
        std::uint32_t expected = FREE;
        return _state.compare_exchange_strong(expected, HELD, std::memory_order_acquire, std::memory_order_relaxed);
    }

    void unlock() {
        if (_state.exchange(FREE, std::memory_order_release) == AWAITED) { wakeWaiter(); }
    }

private:
    static constexpr std::uint32_t FREE = 0;
    static constexpr std::uint32_t HELD = 1;
    /// Held, and perhaps somebody sleeps.
    static constexpr std::uint32_t AWAITED = 2;

    void lockContended();
    void wakeWaiter();

    std::atomic<std::uint32_t> _state{FREE};
};

} // namespace host

#endif
