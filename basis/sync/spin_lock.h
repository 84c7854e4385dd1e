/// \file
/// A lock for a few instructions, without a system call and without memory.

#ifndef BASIS_SYNC_SPIN_LOCK_H
#define BASIS_SYNC_SPIN_LOCK_H

#include <atomic>
#include <thread>

namespace ZOR_Basis {

class SpinLock {
public:
    void lock() {
        for (unsigned tries = 1; taken_.exchange(true, std::memory_order_acquire); ++tries) {
            // The holder may have lost its processor in the middle.
            if (tries % SPINS == 0) std::this_thread::yield();
        }
    }
    void unlock() { taken_.store(false, std::memory_order_release); }

private:
    static constexpr unsigned SPINS = 64;
    std::atomic<bool> taken_{false};
};

} // namespace ZOR_Basis

#endif
