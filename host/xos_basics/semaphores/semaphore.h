/// \file
/// What stands behind a semaphore handle.
///
/// A handle is the address of a block with a generation in its upper 16 bits, and the block knows its handle: a handle
/// that was destroyed is told from the one that uses the block now. Blocks go back to a pool and never to the system,
/// so a thread that wakes a waiter on a semaphore which was destroyed meanwhile touches nothing foreign.

#ifndef HOST_XOS_BASICS_SEMAPHORES_SEMAPHORE_H
#define HOST_XOS_BASICS_SEMAPHORES_SEMAPHORE_H

#include "basis/platform/xos_basics.h"
#include "host/xos_basics/wait/lock_word.h"

#include <atomic>
#include <cstddef>
#include <cstdint>

namespace host {

class NamedMutex;

enum class SemaphoreKind : std::uint32_t { MUTEX, BINARY, NAMED };

/// As long as a cache line, so that neighbours do not slow each other down.
struct alignas(64) Semaphore {
    /// 0 while the block is in the pool.
    std::atomic<xos_Sem> handle;
    LockWord lock;
    SemaphoreKind kind;
    std::uint16_t generation;
    /// Serial of the thread that holds the mutex; 0: none.
    std::atomic<std::uint64_t> owner;
    /// How often the owner has taken it. The owner's alone.
    std::uint64_t depth;
    NamedMutex* named;
    Semaphore* nextFree;
};

static_assert(sizeof(Semaphore) == 64);

constexpr int GENERATION_SHIFT = 48;
constexpr std::uint64_t ADDRESS_MASK = (std::uint64_t{1} << GENERATION_SHIFT) - 1;

/// \return null for handle 0 and for a handle that was destroyed
inline Semaphore* semaphoreOf(xos_Sem handle) {
    auto* const semaphore = reinterpret_cast<Semaphore*>(handle & ADDRESS_MASK);
    bool const isCurrent = semaphore != nullptr && semaphore->handle.load(std::memory_order_relaxed) == handle;
    return isCurrent ? semaphore : nullptr;
}

/// A block of the pool with a new handle.
/// \param state  of a binary semaphore or mutex: WORD_FREE or WORD_HELD
/// \return null without memory; the last error is then set
Semaphore* makeSemaphore(SemaphoreKind kind, std::uint32_t state);

/// Ends the handle.
void freeSemaphore(Semaphore* semaphore);

} // namespace host

#endif
