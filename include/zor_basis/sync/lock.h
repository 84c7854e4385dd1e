/// \file
/// `Lock`: one semaphore of the platform layer, locked and unlocked by hand.
///
/// \thread  thread-safe, construction and destruction excepted

#ifndef ZOR_BASIS_SYNC_LOCK_H
#define ZOR_BASIS_SYNC_LOCK_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API Lock {
public:
    enum Type : std::uint32_t {
        Binary = 0, ///< any thread may unlock
        Mutex = 1,  ///< the locking thread unlocks, and may lock again meanwhile; so is any other value
    };

    /// \param locked  begins locked: a mutex by the calling thread, a binary semaphore by nobody, so that the first `lock`
    ///        of whatever thread waits for an `unlock`
    /// \error a semaphore that cannot be made leaves a lock that locks nothing
    Lock(Type type, bool locked);
    Lock(Lock const&) = delete;
    /// Shares the semaphore.
    /// \kept sync-01: both objects destroy it, so a lock that is in use is never assigned; what this one had is lost
    Lock& operator=(Lock const& other);
    /// Destroys the semaphore, locked or not.
    ~Lock();

    /// Waits for the semaphore without limit.
    void lock();
    void unlock();

private:
    std::uint64_t handle_;
};

static_assert(sizeof(Lock) == 8);

} // namespace ZOR_Basis

#endif
