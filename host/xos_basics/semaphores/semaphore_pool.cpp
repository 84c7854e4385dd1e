#include "host/xos_basics/control/call_record.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/semaphores/semaphore.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include <array>
#include <mutex>
#include <new>

namespace host {

namespace {

/// Blocks move between a thread's own store and the common one by the batch.
constexpr std::uint32_t BATCH = 16;

/// Blocks that were made together. A handle hides its block's address from leak checkers, so all blocks are kept in a
/// list.
struct Slab {
    std::array<Semaphore, BATCH> blocks;
    Slab* older;
};

constinit QuickMutex poolMutex;
constinit Semaphore* pool = nullptr;
constinit Slab* slabs = nullptr;

void push(Semaphore*& list, Semaphore* semaphore) {
    semaphore->nextFree = list;
    list = semaphore;
}

Semaphore* pop(Semaphore*& list) {
    Semaphore* const first = list;
    if (first != nullptr) list = first->nextFree;
    return first;
}

/// \pre the mutex is held
bool fillPool() {
    if (pool != nullptr) return true;
    auto* const slab = new (std::nothrow) Slab();
    if (slab == nullptr) return false;
    slab->older = slabs;
    slabs = slab;
    for (Semaphore& block : slab->blocks) { push(pool, &block); }
    return true;
}

void refill(ThreadCalls& mine) {
    std::lock_guard const lock{poolMutex};
    while (mine.freeSemaphoreCount < BATCH && fillPool()) {
        push(mine.freeSemaphores, pop(pool));
        ++mine.freeSemaphoreCount;
    }
}

void giveBatchBack(ThreadCalls& mine) {
    std::lock_guard const lock{poolMutex};
    for (std::uint32_t i = 0; i < BATCH; ++i) {
        push(pool, pop(mine.freeSemaphores));
        --mine.freeSemaphoreCount;
    }
}

/// A thread without records of its own has no store either.
bool hasOwnStore(ThreadCalls const& mine) { return mine.threadSerial != 0; }

Semaphore* takeBlock() {
    ThreadCalls& mine = threadCalls();
    if (!hasOwnStore(mine)) {
        std::lock_guard const lock{poolMutex};
        return fillPool() ? pop(pool) : nullptr;
    }
    if (mine.freeSemaphores == nullptr) refill(mine);
    Semaphore* const block = pop(mine.freeSemaphores);
    if (block != nullptr) --mine.freeSemaphoreCount;
    return block;
}

} // namespace

Semaphore* makeSemaphore(SemaphoreKind kind, std::uint32_t state) {
    Semaphore* const semaphore = takeBlock();
    if (semaphore == nullptr) {
        setLastError(Error::noMemory);
        return nullptr;
    }
    semaphore->kind = kind;
    semaphore->lock.held.store(state, std::memory_order_relaxed);
    semaphore->lock.awaited.store(0, std::memory_order_relaxed);
    semaphore->owner.store(0, std::memory_order_relaxed);
    semaphore->depth = 0;
    semaphore->time.store(0, std::memory_order_relaxed);
    semaphore->named = nullptr;
    ++semaphore->generation;
    std::uint64_t const address = reinterpret_cast<std::uintptr_t>(semaphore);
    semaphore->handle.store(address | std::uint64_t{semaphore->generation} << GENERATION_SHIFT,
                            std::memory_order_relaxed);
    return semaphore;
}

void freeSemaphore(Semaphore* semaphore) {
    semaphore->handle.store(0, std::memory_order_relaxed);
    ThreadCalls& mine = threadCalls();
    if (!hasOwnStore(mine)) {
        std::lock_guard const lock{poolMutex};
        push(pool, semaphore);
        return;
    }
    push(mine.freeSemaphores, semaphore);
    if (++mine.freeSemaphoreCount > 2 * BATCH) giveBatchBack(mine);
}

} // namespace host
