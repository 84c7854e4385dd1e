// Locks by number beside what one would write with the standard library: a map of counted mutexes under one mutex.

#include <zor_basis/sync.h>

#include <benchmark/benchmark.h>

#include <memory>
#include <mutex>
#include <random>
#include <unordered_map>

using namespace ZOR_Basis;

namespace {

constexpr std::uint64_t KEYS = 1000;

class MutexMap {
public:
    void take(std::uint64_t key) {
        std::mutex* mutex = nullptr;
        {
            std::lock_guard const lock(mapMutex_);
            auto& slot = map_[key];
            if (slot == nullptr) slot = std::make_unique<Counted>();
            ++slot->users;
            mutex = &slot->mutex;
        }
        mutex->lock();
    }
    void give(std::uint64_t key) {
        std::lock_guard const lock(mapMutex_);
        auto const place = map_.find(key);
        place->second->mutex.unlock();
        if (--place->second->users == 0) map_.erase(place);
    }

private:
    struct Counted {
        std::mutex mutex;
        std::uint64_t users = 0;
    };
    std::mutex mapMutex_;
    std::unordered_map<std::uint64_t, std::unique_ptr<Counted>> map_;
};

SemSet ourSet(KEYS);
MutexMap theirMap;

void takeOurs(benchmark::State& state) {
    std::mt19937_64 random(static_cast<std::uint64_t>(state.thread_index()));
    for (auto _ : state) {
        std::uint64_t const key = random() % KEYS;
        ourSet->take(key);
        ourSet->give(key);
    }
}

void takeTheirs(benchmark::State& state) {
    std::mt19937_64 random(static_cast<std::uint64_t>(state.thread_index()));
    for (auto _ : state) {
        std::uint64_t const key = random() % KEYS;
        theirMap.take(key);
        theirMap.give(key);
    }
}

constexpr std::uint64_t HOT_KEY = 7;

/// What a key guards: the work of a few instructions.
std::uint64_t guarded = 0;

void takeHotOurs(benchmark::State& state) {
    for (auto _ : state) {
        ourSet->take(HOT_KEY);
        benchmark::DoNotOptimize(++guarded);
        ourSet->give(HOT_KEY);
    }
}

void takeHotTheirs(benchmark::State& state) {
    for (auto _ : state) {
        theirMap.take(HOT_KEY);
        benchmark::DoNotOptimize(++guarded);
        theirMap.give(HOT_KEY);
    }
}

BENCHMARK(takeOurs)->Name("keys-one-thread/ours");
BENCHMARK(takeTheirs)->Name("keys-one-thread/mutex-map");
BENCHMARK(takeOurs)->Name("keys-two-threads/ours")->Threads(2)->UseRealTime();
BENCHMARK(takeTheirs)->Name("keys-two-threads/mutex-map")->Threads(2)->UseRealTime();
BENCHMARK(takeHotOurs)->Name("hot-key-two-threads/ours")->Threads(2)->UseRealTime();
BENCHMARK(takeHotTheirs)->Name("hot-key-two-threads/mutex-map")->Threads(2)->UseRealTime();

} // namespace
