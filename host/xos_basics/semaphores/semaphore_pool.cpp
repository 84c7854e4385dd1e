#include "host/xos_basics/last_error.h"
#include "host/xos_basics/semaphores/semaphore.h"
#include "host/xos_basics/this_thread.h"
#include "host/xos_basics/thread_end.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include <array>
#include <memory>
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

} // namespace

/// Blocks that one thread has at hand. On the heap, because it is used when thread-local memory may have been freed.
struct ThreadStore {
    Semaphore* free;
    std::uint32_t count;
};

namespace {

void giveBlocksBack(ThreadStore& mine, std::uint32_t count) {
    std::lock_guard const lock{poolMutex};
    for (; count != 0; --count, --mine.count) { push(pool, pop(mine.free)); }
}

void endStore(void* store) {
    thisThread.store = nullptr;
    std::unique_ptr<ThreadStore> const mine{static_cast<ThreadStore*>(store)};
    giveBlocksBack(*mine, mine->count);
}

/// \return null without memory
ThreadStore* ownStore() {
    if (thisThread.store != nullptr) return thisThread.store;
    static ThreadEnd const end{endStore};
    thisThread.store = new (std::nothrow) ThreadStore{};
    if (thisThread.store != nullptr) end.set(thisThread.store);
    return thisThread.store;
}

void refill(ThreadStore& mine) {
    std::lock_guard const lock{poolMutex};
    while (mine.count < BATCH && fillPool()) {
        push(mine.free, pop(pool));
        ++mine.count;
    }
}

Semaphore* takeBlock() {
    ThreadStore* const mine = ownStore();
    if (mine == nullptr) {
        std::lock_guard const lock{poolMutex};
        return fillPool() ? pop(pool) : nullptr;
    }
    if (mine->free == nullptr) refill(*mine);
    Semaphore* const block = pop(mine->free);
    if (block != nullptr) --mine->count;
    return block;
}

} // namespace

Semaphore* makeSemaphore(SemaphoreKind kind, std::uint32_t state) {
    Semaphore* const semaphore = takeBlock();
    if (semaphore == nullptr) {
        setLastError(Error::NO_MEMORY);
        return nullptr;
    }
    semaphore->kind = kind;
    semaphore->lock.held.store(state, std::memory_order_relaxed);
    semaphore->lock.awaited.store(0, std::memory_order_relaxed);
    semaphore->owner.store(0, std::memory_order_relaxed);
    semaphore->depth = 0;
    semaphore->named = nullptr;
    ++semaphore->generation;
    std::uint64_t const address = reinterpret_cast<std::uintptr_t>(semaphore);
    semaphore->handle.store(address | std::uint64_t{semaphore->generation} << GENERATION_SHIFT,
                            std::memory_order_relaxed);
    return semaphore;
}

void freeSemaphore(Semaphore* semaphore) {
    semaphore->handle.store(0, std::memory_order_relaxed);
    ThreadStore* const mine = ownStore();
    if (mine == nullptr) {
        std::lock_guard const lock{poolMutex};
        push(pool, semaphore);
        return;
    }
    push(mine->free, semaphore);
    if (++mine->count > 2 * BATCH) giveBlocksBack(*mine, BATCH);
}

} // namespace host
