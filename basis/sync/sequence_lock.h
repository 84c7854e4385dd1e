/// \file
/// Lets readers go without a lock and see afterwards whether they read something whole. Writers exclude each other by
/// other means; where they fail to, the number comes to rest all the same, so that no reader waits forever. What is
/// guarded is read with acquire and written with release order, which keeps it between the looks at the number.

#ifndef BASIS_SYNC_SEQUENCE_LOCK_H
#define BASIS_SYNC_SEQUENCE_LOCK_H

#include <atomic>
#include <cstdint>
#include <thread>

namespace ZOR_Basis {

class SequenceLock {
public:
    /// \name Writing
    /// @{
    void beginWriting() { sequence_.store(sequence_.load(std::memory_order_relaxed) | 1, std::memory_order_relaxed); }
    void endWriting() {
        sequence_.store((sequence_.load(std::memory_order_relaxed) | 1) + 1, std::memory_order_release);
    }
    /// @}

    /// \name Reading
    /// @{

    /// Waits for a writer to finish.
    /// \return what `isUnchanged` compares with
    std::uint32_t beginReading() const {
        for (unsigned tries = 1;; ++tries) {
            std::uint32_t const now = sequence_.load(std::memory_order_acquire);
            if (now % 2 == 0) return now;
            // The writer may have lost its processor in the middle.
            if (tries % SPINS == 0) std::this_thread::yield();
        }
    }
    bool isUnchanged(std::uint32_t since) const { return sequence_.load(std::memory_order_acquire) == since; }
    /// @}

private:
    static constexpr unsigned SPINS = 64;
    std::atomic<std::uint32_t> sequence_{0};
};

} // namespace ZOR_Basis

#endif
