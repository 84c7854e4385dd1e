/// \file
/// `Lock`: one semaphore of the platform layer, locked and unlocked explicitly.
///
///     Lock lock(Lock::Mutex, false);
///     lock.lock();
///     ++shared;
///     lock.unlock();
///
/// \thread thread-safe, except construction and destruction

#ifndef ZOR_BASIS_SYNC_LOCK_H
#define ZOR_BASIS_SYNC_LOCK_H

#include "zor_basis/export.h"

#include <cstdint>

namespace ZOR_Basis {

class ZB_API Lock {
public:
    /// Which threads may unlock.
    enum Type : std::uint32_t {
        Binary = 0, ///< any thread may unlock
        Mutex = 1,  ///< the locking thread unlocks, and may lock again meanwhile; any other value means the same
    };

    /// \param locked  makes the lock begin locked: a mutex by the calling thread; a binary semaphore without an owner,
    ///     so that the first `lock` by any thread waits for an `unlock`
    /// \error if the semaphore cannot be made, the lock locks nothing
    Lock(Type type, bool locked);
    Lock(Lock const&) = delete;
    /// Shares the other's semaphore.
    /// \kept sync-01: both objects destroy the shared semaphore, so a lock in use must not be assigned; the semaphore
    ///     that this object had is leaked
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
