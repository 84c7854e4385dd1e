// The queue of jobs beside a thread for each job, `std::async` and the tasks of TBB.

#include <zor_basis/sync.h>

#include <benchmark/benchmark.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdint>
#include <future>
#include <latch>
#include <memory>
#include <thread>
#include <vector>

#ifdef BENCH_HAS_TBB
#include <tbb/task_group.h>
#endif

using namespace ZOR_Basis;

namespace {

constexpr int TRIVIAL_JOBS = 10'000;
constexpr int LONG_JOBS = 200;

/* What jobs do */

struct Trivial {
    static constexpr int JOBS = TRIVIAL_JOBS;
    static void work() {}
};

/// A step that nothing can shorten.
std::uint64_t turn(std::uint64_t rounds) {
    std::uint64_t word = 88'172'645'463'325'252u;
    for (std::uint64_t i = 0; i < rounds; ++i) {
        word ^= word << 13;
        word ^= word >> 7;
        word ^= word << 17;
    }
    return word;
}

/// The rounds that take a millisecond where nobody disturbs.
std::uint64_t roundsOfOneMs() {
    constexpr std::uint64_t ROUNDS = 1'000'000;
    double best = 1;
    for (int i = 0; i < 20; ++i) {
        auto const start = std::chrono::steady_clock::now();
        benchmark::DoNotOptimize(turn(ROUNDS));
        best = std::min(best, std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count());
    }
    return static_cast<std::uint64_t>(ROUNDS * 1e-3 / best);
}

std::uint64_t const oneMs = roundsOfOneMs();

struct OneMs {
    static constexpr int JOBS = LONG_JOBS;
    static void work() { benchmark::DoNotOptimize(turn(oneMs)); }
};

/* Who runs them */

std::atomic<int> done;

template <class Job>
bool runJob(void*) {
    Job::work();
    done.fetch_add(1, std::memory_order_relaxed);
    return true;
}

std::unique_ptr<MultiTaskQueue> makeQueue(int limit) {
    return std::unique_ptr<MultiTaskQueue>(MultiTaskQueue::New(MultiTaskQueue::Continue, limit));
}

template <class Job>
void byQueue() {
    auto const queue = makeQueue(0);
    for (int i = 0; i < Job::JOBS; ++i) queue->add(runJob<Job>, nullptr, false, true, false);
    queue->wait();
}

template <class Job>
void byThread() {
    std::latch left(Job::JOBS);
    for (int i = 0; i < Job::JOBS; ++i) {
        std::thread([&left] {
            runJob<Job>(nullptr);
            left.count_down();
        }).detach();
    }
    left.wait();
}

template <class Job>
void byAsync() {
    std::vector<std::future<bool>> futures;
    futures.reserve(Job::JOBS);
    for (int i = 0; i < Job::JOBS; ++i) futures.push_back(std::async(std::launch::async, runJob<Job>, nullptr));
    for (std::future<bool>& future : futures) future.wait();
}

#ifdef BENCH_HAS_TBB
template <class Job>
void byTbb() {
    tbb::task_group group;
    for (int i = 0; i < Job::JOBS; ++i) group.run([] { runJob<Job>(nullptr); });
    group.wait();
}
#endif

bool waitForTheOthers(void* jobs) {
    while (done.load() < *static_cast<int*>(jobs)) std::this_thread::yield();
    return true;
}

/// All jobs wait until the queue is waited for; one that runs meanwhile keeps it at work.
template <class Job>
void byWait() {
    auto const queue = makeQueue(0);
    int jobs = Job::JOBS;
    for (int i = 0; i < jobs; ++i) queue->add(runJob<Job>, nullptr, false, false, false);
    queue->add(waitForTheOthers, &jobs, false, true, false);
    queue->add([](void*) { return true; }, nullptr, false, true, false);
    queue->wait();
}

template <class Job, void (*ALL)()>
void run(benchmark::State& state) {
    for (auto _ : state) {
        done = 0;
        ALL();
        if (done != Job::JOBS) state.SkipWithError("jobs were lost");
    }
}

BENCHMARK(run<Trivial, byQueue<Trivial>>)->Name("trivial-10000/ours")->UseRealTime();
BENCHMARK(run<Trivial, byThread<Trivial>>)->Name("trivial-10000/thread")->UseRealTime();
BENCHMARK(run<Trivial, byAsync<Trivial>>)->Name("trivial-10000/async")->UseRealTime();
BENCHMARK(run<Trivial, byWait<Trivial>>)->Name("trivial-10000-by-wait/ours")->UseRealTime();
BENCHMARK(run<OneMs, byQueue<OneMs>>)->Name("work-200/ours")->UseRealTime();
BENCHMARK(run<OneMs, byThread<OneMs>>)->Name("work-200/thread")->UseRealTime();
BENCHMARK(run<OneMs, byAsync<OneMs>>)->Name("work-200/async")->UseRealTime();
#ifdef BENCH_HAS_TBB
BENCHMARK(run<Trivial, byTbb<Trivial>>)->Name("trivial-10000/tbb")->UseRealTime();
BENCHMARK(run<OneMs, byTbb<OneMs>>)->Name("work-200/tbb")->UseRealTime();
#endif

} // namespace
