// Mutexes and tasks of the stand-alone platform layer beside those of the system and of the standard library.

#include "basis/platform/xos_basics.h"

#include <benchmark/benchmark.h>

#include <atomic>
#include <cstdint>
#include <future>
#include <mutex>
#include <pthread.h>
#include <semaphore>
#include <thread>
#include <vector>

namespace {

class HostMutex {
public:
    HostMutex() : handle_(xos_SemMCreate()) {}
    ~HostMutex() { xos_SemDestroy(handle_); }
    void take() { xos_SemTake(handle_); }
    void give() { xos_SemGive(handle_); }

private:
    xos_Sem handle_;
};

class PthreadMutex {
public:
    PthreadMutex() {
        pthread_mutexattr_t attributes;
        pthread_mutexattr_init(&attributes);
        pthread_mutexattr_settype(&attributes, PTHREAD_MUTEX_RECURSIVE);
        pthread_mutex_init(&mutex_, &attributes);
        pthread_mutexattr_destroy(&attributes);
    }
    ~PthreadMutex() { pthread_mutex_destroy(&mutex_); }
    void take() { pthread_mutex_lock(&mutex_); }
    void give() { pthread_mutex_unlock(&mutex_); }

private:
    pthread_mutex_t mutex_{};
};

template <class Mutex>
void takeAndGive(benchmark::State& state) {
    Mutex mutex;
    for (auto _ : state) {
        mutex.take();
        mutex.give();
    }
}

template <class Mutex>
void takeAndGiveShared(benchmark::State& state) {
    static Mutex mutex;
    static std::uint64_t guarded = 0;
    for (auto _ : state) {
        mutex.take();
        benchmark::DoNotOptimize(++guarded);
        mutex.give();
    }
}

template <class Mutex>
void makeAndDestroy(benchmark::State& state) {
    for (auto _ : state) {
        Mutex mutex;
        benchmark::DoNotOptimize(&mutex);
    }
}

constexpr int JOBS = 10'000;
constexpr int MOST_UNFINISHED = 64;

/// Lets so many jobs be unfinished at a time, and waits for the last of them.
class Unfinished {
public:
    void begin() { free_.acquire(); }
    void end() {
        done_.fetch_add(1, std::memory_order_relaxed);
        free_.release();
    }
    void waitForAll() {
        for (int i = 0; i < MOST_UNFINISHED; ++i) { free_.acquire(); }
        free_.release(MOST_UNFINISHED);
    }
    int done() const { return done_.load(); }

private:
    std::counting_semaphore<MOST_UNFINISHED> free_{MOST_UNFINISHED};
    std::atomic<int> done_{0};
};

void endJob(void* unfinished) { static_cast<Unfinished*>(unfinished)->end(); }

struct HostTask {
    static void start(Unfinished& unfinished) {
        xos_TaskParams const params{endJob, &unfinished, 0, -9, 0, "bench", 0};
        xos_TaskCreate(&params);
    }
};

struct ThreadTask {
    static void start(Unfinished& unfinished) { std::thread(endJob, &unfinished).detach(); }
};

struct AsyncTask {
    static void start(Unfinished& unfinished) {
        // A future waits for its job when it is dropped, so as many are kept as may be unfinished.
        static std::vector<std::future<void>> futures(MOST_UNFINISHED);
        static std::size_t next = 0;
        futures[next++ % MOST_UNFINISHED] = std::async(std::launch::async, endJob, &unfinished);
    }
};

template <class Task>
void runJobs(benchmark::State& state) {
    for (auto _ : state) {
        Unfinished unfinished;
        for (int i = 0; i < JOBS; ++i) {
            unfinished.begin();
            Task::start(unfinished);
        }
        unfinished.waitForAll();
        if (unfinished.done() != JOBS) state.SkipWithError("jobs were lost");
    }
    state.SetItemsProcessed(state.iterations() * JOBS);
}

/// As in every program that needs a mutex: once a second thread has existed, the C library no longer takes short cuts.
bool const hasHadThreads = [] {
    std::thread([] {}).join();
    return true;
}();

BENCHMARK(takeAndGive<HostMutex>)->Name("mutex_uncontended/ours");
BENCHMARK(takeAndGive<PthreadMutex>)->Name("mutex_uncontended/pthread");
BENCHMARK(takeAndGiveShared<HostMutex>)->Name("mutex_contended/ours")->Threads(2)->UseRealTime();
BENCHMARK(takeAndGiveShared<PthreadMutex>)->Name("mutex_contended/pthread")->Threads(2)->UseRealTime();
BENCHMARK(takeAndGive<HostMutex>)->Name("mutex_each_its_own/ours")->Threads(2)->UseRealTime();
BENCHMARK(takeAndGive<PthreadMutex>)->Name("mutex_each_its_own/pthread")->Threads(2)->UseRealTime();
BENCHMARK(makeAndDestroy<HostMutex>)->Name("mutex_make_destroy/ours");
BENCHMARK(makeAndDestroy<PthreadMutex>)->Name("mutex_make_destroy/pthread");
BENCHMARK(runJobs<HostTask>)->Name("tasks_10000/ours")->UseRealTime()->Unit(benchmark::kMillisecond);
BENCHMARK(runJobs<ThreadTask>)->Name("tasks_10000/thread")->UseRealTime()->Unit(benchmark::kMillisecond);
BENCHMARK(runJobs<AsyncTask>)->Name("tasks_10000/async")->UseRealTime()->Unit(benchmark::kMillisecond);

} // namespace
