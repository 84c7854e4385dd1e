#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/result.h"
#include "host/xos_basics/semaphores/named_mutex.h"
#include "host/xos_basics/semaphores/semaphore.h"
#include "host/xos_basics/tasks/deferred_threads.h"
#include "host/xos_basics/wait/lock_word.h"

#include <atomic>
#include <cstdint>

using host::call;
using host::Function;

namespace {

int failWith(host::Error error) {
    host::setLastError(error);
    return host::FAILED;
}

/// Identifies the calling thread as the owner of a mutex.
inline std::uint64_t ownSerial() {
    static constinit std::atomic<std::uint64_t> lastSerial{0};
    std::uint64_t& serial = host::thisThread.serial;
    if (serial == 0) serial = lastSerial.fetch_add(1, std::memory_order_relaxed) + 1;
    return serial;
}

inline void takeState(host::Semaphore& semaphore) {
    if (host::isTakenAtOnce(semaphore.lock)) return;
    host::provideDeferredThreads();
    host::takeContended(semaphore.lock);
}

int takeMutex(host::Semaphore& mutex) {
    std::uint64_t const self = ownSerial();
    if (mutex.owner.load(std::memory_order_relaxed) == self) {
        ++mutex.depth;
        return 0;
    }
    takeState(mutex);
    mutex.owner.store(self, std::memory_order_relaxed);
    mutex.depth = 1;
    ++host::thisThread.heldMutexes;
    return 0;
}

int giveMutex(host::Semaphore& mutex) {
    if (mutex.owner.load(std::memory_order_relaxed) != ownSerial()) return failWith(host::Error::NOT_OWNER);
    if (--mutex.depth == 0) {
        mutex.owner.store(0, std::memory_order_relaxed);
        host::giveWord(mutex.lock);
        if (--host::thisThread.heldMutexes == 0) host::provideDeferredThreads();
    }
    return 0;
}

/// A mutex that ends while its owner holds it is held no longer.
void leaveMutex(host::Semaphore const& mutex) {
    if (mutex.owner.load(std::memory_order_relaxed) == ownSerial()) --host::thisThread.heldMutexes;
}

int takeBinary(host::Semaphore& semaphore) {
    takeState(semaphore);
    return 0;
}

int giveBinary(host::Semaphore& semaphore) {
    host::giveWord(semaphore.lock);
    return 0;
}

xos_Sem handleOf(host::Semaphore const* semaphore) { return semaphore == nullptr ? 0 : semaphore->handle.load(); }

/// Into the functions themselves: most calls return before another one would have begun.
HOST_INLINE int take(xos_Sem sem) {
    host::Semaphore* const semaphore = host::semaphoreOf(sem);
    if (semaphore == nullptr) return failWith(host::Error::BAD_HANDLE);
    switch (semaphore->kind) {
    case host::SemaphoreKind::MUTEX:
        return takeMutex(*semaphore);
    case host::SemaphoreKind::BINARY:
        return takeBinary(*semaphore);
    default:
        return host::takeNamed(*semaphore->named);
    }
}

HOST_INLINE int give(xos_Sem sem) {
    host::Semaphore* const semaphore = host::semaphoreOf(sem);
    if (semaphore == nullptr) return failWith(host::Error::BAD_HANDLE);
    switch (semaphore->kind) {
    case host::SemaphoreKind::MUTEX:
        return giveMutex(*semaphore);
    case host::SemaphoreKind::BINARY:
        return giveBinary(*semaphore);
    default:
        return host::giveNamed(*semaphore->named);
    }
}

int destroy(xos_Sem sem) {
    host::Semaphore* const semaphore = host::semaphoreOf(sem);
    if (semaphore == nullptr) return failWith(host::Error::BAD_HANDLE);
    if (semaphore->kind == host::SemaphoreKind::MUTEX) leaveMutex(*semaphore);
    // A named mutex is the process's, not the caller's: others hold the same handle.
    if (semaphore->kind != host::SemaphoreKind::NAMED) host::freeSemaphore(semaphore);
    return 0;
}

} // namespace

extern "C" {

xos_Sem xos_SemMCreate(void) {
    auto const create = [] { return handleOf(host::makeSemaphore(host::SemaphoreKind::MUTEX, host::WORD_FREE)); };
    return call<xos_Sem>(Function::xos_SemMCreate, 0, create);
}

xos_Sem xos_SemBCreate(int available) {
    auto const create = [=] {
        std::uint32_t const state = available != 0 ? host::WORD_FREE : host::WORD_HELD;
        return handleOf(host::makeSemaphore(host::SemaphoreKind::BINARY, state));
    };
    return call<xos_Sem>(Function::xos_SemBCreate, 0, create, available);
}

int xos_SemTake(xos_Sem sem) {
    return call(
        Function::xos_SemTake, host::FAILED, [=] { return take(sem); }, sem);
}

int xos_SemGive(xos_Sem sem) {
    return call(
        Function::xos_SemGive, host::FAILED, [=] { return give(sem); }, sem);
}

int xos_SemDestroy(xos_Sem sem) {
    return call(
        Function::xos_SemDestroy, host::FAILED, [=] { return destroy(sem); }, sem);
}

} // extern "C"
