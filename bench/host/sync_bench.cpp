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
    HostMutex() : _handle(xos_SemMCreate()) {}
    ~HostMutex() { xos_SemDestroy(_handle); }
    void take() { xos_SemTake(_handle); }
    void give() { xos_SemGive(_handle); }

private:
    xos_Sem _handle;
};

class PthreadMutex {
public:
    PthreadMutex() {
        pthread_mutexattr_t attributes;
        pthread_mutexattr_init(&attributes);
        pthread_mutexattr_settype(&attributes, PTHREAD_MUTEX_RECURSIVE);
        pthread_mutex_init(&_mutex, &attributes);
        pthread_mutexattr_destroy(&attributes);
    }
    ~PthreadMutex() { pthread_mutex_destroy(&_mutex); }
    void take() { pthread_mutex_lock(&_mutex); }
    void give() { pthread_mutex_unlock(&_mutex); }

private:
    pthread_mutex_t _mutex{};
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

BENCHMARK(takeAndGive<HostMutex>)->Name("mutex_uncontended/ours");
BENCHMARK(takeAndGive<PthreadMutex>)->Name("mutex_uncontended/pthread");
BENCHMARK(takeAndGiveShared<HostMutex>)->Name("mutex_contended/ours")->Threads(2)->UseRealTime();
BENCHMARK(takeAndGiveShared<PthreadMutex>)->Name("mutex_contended/pthread")->Threads(2)->UseRealTime();
BENCHMARK(makeAndDestroy<HostMutex>)->Name("mutex_make_destroy/ours");
BENCHMARK(makeAndDestroy<PthreadMutex>)->Name("mutex_make_destroy/pthread");

} // namespace
