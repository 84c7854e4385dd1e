/// \file
/// A lock that readers do not take: they read, and then check whether a writer has interfered. Writers exclude each
/// other by other means; if those fail, the number still becomes even in the end, so that no reader waits forever. The
/// guarded data is read with acquire and written with release order, which keeps it between the reads of the number.

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
