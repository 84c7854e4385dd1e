#include "host/xos_basics/tasks/deferred_threads.h"

#include "host/xos_basics/tasks/task_thread.h"
#include "host/xos_basics/wait/word_wait.h"

#include <atomic>
#include <chrono>
#include <thread>

namespace host {

namespace {

/// How long a task may wait for its creator.
constexpr std::chrono::milliseconds PATIENCE{4};

constexpr std::uint32_t RESTING = 0;
constexpr std::uint32_t WATCHING = 1;
constinit std::atomic<std::uint32_t> watch{RESTING};

/// Set before any threads are deferred.
constinit std::atomic<ThreadProvider> threadProvider{nullptr};

void askProvider() { threadProvider.load(std::memory_order_relaxed)(); }

void watchCreators(void*) {
    for (;;) {
        while (watch.load(std::memory_order_relaxed) == RESTING) { waitWhile(watch, RESTING); }
        std::this_thread::sleep_for(PATIENCE);
        // Before the look under the pool's mutex: a creator whose job comes after that look reads it and starts the
        // watch.
        watch.store(RESTING, std::memory_order_relaxed);
        askProvider();
    }
}

/// \return false: there is no thread for it
bool startWatch() {
    static bool const exists = startThread(watchCreators, nullptr, 0);
    if (!exists) return false;
    if (watch.load(std::memory_order_relaxed) == RESTING && watch.exchange(WATCHING) == RESTING) wakeOne(watch);
    return true;
}

} // namespace

bool deferThreads(ThreadProvider provider) {
    if (thisThread.heldMutexes == 0) return false;
    threadProvider.store(provider, std::memory_order_relaxed);
    thisThread.hasDeferredThreads = startWatch();
    return thisThread.hasDeferredThreads;
}

void provideThreadsNow() {
    thisThread.hasDeferredThreads = false;
    askProvider();
}

} // namespace host
