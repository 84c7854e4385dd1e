// Timers beside the readings of the clock that they cannot do without, and a report beside the same rows by snprintf.

#include "bench/support/scratch_root.h"

#include <zor_basis/files/file.h>
#include <zor_basis/timers.h>

#include "basis/platform/xos_basics.h"

#include <benchmark/benchmark.h>

#include <array>
#include <chrono>
#include <cstdint>
#include <cstdio>
#include <filesystem>
#include <mutex>
#include <string>
#include <unistd.h>
#include <vector>

namespace fs = std::filesystem;
using namespace ZOR_Basis;

namespace {

ScratchRoot const root("timer");

fs::path reports() { return workplace() / "timer"; }
void removeReports() {
    for (auto const& entry : fs::directory_iterator(reports())) fs::remove(entry);
}

std::int64_t reading() {
    timespec time;
    clock_gettime(CLOCK_MONOTONIC, &time);
    return time.tv_sec * 1'000'000'000 + time.tv_nsec;
}

TimerMgr* makeManager(char const* name, bool active) {
    TimerMgr* const manager = TimerMgr::New(name, 1);
    TimerMgr::create(manager, "stage", 1, false);
    manager->setActive(active);
    return manager;
}

/* One measurement */

void pile(benchmark::State& state) {
    PileTimer timer("stage", true);
    for (auto _ : state) {
        timer.start(false);
        timer.stop();
    }
}

void byId(benchmark::State& state, bool active) {
    static TimerMgr* const managers[] = {makeManager("inactive", false), makeManager("active", true)};
    TimerMgr* manager = managers[active ? 1 : 0];
    for (auto _ : state) {
        benchmark::DoNotOptimize(manager);
        manager->start(1);
        manager->stop(1);
    }
}

void twoReadings(benchmark::State& state) {
    for (auto _ : state) {
        std::int64_t const start = reading();
        std::int64_t elapsed = reading() - start;
        benchmark::DoNotOptimize(elapsed);
    }
}

/// A yardstick: what ran is not looked at.
void twoNanoseconds(benchmark::State& state) {
    for (auto _ : state) state.SetIterationTime(2e-9);
}

BENCHMARK(pile)->Name("pile-start-stop/ours");
BENCHMARK(twoReadings)->Name("pile-start-stop/two-readings");
BENCHMARK_CAPTURE(byId, active, true)->Name("by-id-active/ours");
BENCHMARK(twoReadings)->Name("by-id-active/two-readings");
BENCHMARK_CAPTURE(byId, inactive, false)->Name("by-id-inactive/ours");
BENCHMARK(twoNanoseconds)->Name("by-id-inactive/two-nanoseconds")->UseManualTime();

/* Into a shared pile */

PileTimer* sharedPile() {
    static PileTimer* const shared = TimerMgr::create(TimerMgr::New("shared", 1), "shared", 1, true);
    return shared;
}

void intoShared(benchmark::State& state) {
    PileTimer* const shared = sharedPile();
    for (auto _ : state) {
        BaseTimer timer(true, false);
        timer.stop(shared);
    }
}

void readingsAndMutex(benchmark::State& state) {
    static xos_Sem const semaphore = xos_SemMCreate();
    for (auto _ : state) {
        std::int64_t const start = reading();
        std::int64_t elapsed = reading() - start;
        benchmark::DoNotOptimize(elapsed);
        xos_SemTake(semaphore);
        xos_SemGive(semaphore);
    }
}

void guardedSum(benchmark::State& state) {
    static std::mutex mutex;
    static std::int64_t sum = 0;
    for (auto _ : state) {
        std::int64_t const start = reading();
        std::int64_t const elapsed = reading() - start;
        std::lock_guard const held(mutex);
        sum += elapsed;
    }
}

BENCHMARK(intoShared)->Name("shared-one-thread/ours");
BENCHMARK(readingsAndMutex)->Name("shared-one-thread/readings-and-mutex");
BENCHMARK(intoShared)->Name("shared-two-threads/ours")->Threads(2)->UseRealTime();
BENCHMARK(guardedSum)->Name("shared-two-threads/guarded-sum")->Threads(2)->UseRealTime();

/* A report */

constexpr int TIMERS = 10'000;

std::string nameOf(int i) { return "stage " + std::to_string(i) + " of the pipeline"; }

/// What the timers hold before each report, so that the numbers have many digits.
void fill(PileTimer& timer, int i) {
    for (std::int64_t round = 1; round <= 3; ++round) {
        BaseTimer measured;
        static_cast<zbTimerDat&>(measured) = {1, 1 + round * 1'234'567'890 * (i % 7 + 1), 0, round * 7'654'321};
        timer.addTotal(measured);
    }
}

void report(benchmark::State& state) {
    static TimerMgr* const manager = [] {
        TimerMgr* const made = TimerMgr::New("report", TIMERS);
        for (int i = 1; i <= TIMERS; ++i)
            TimerMgr::create(made, nameOf(i).c_str(), static_cast<std::uint64_t>(i), false);
        made->setActive(true);
        return made;
    }();
    for (auto _ : state) {
        state.PauseTiming();
        removeReports();
        for (int i = 1; i <= TIMERS; ++i) fill(*manager->getTimer(static_cast<std::uint64_t>(i)), i);
        state.ResumeTiming();
        manager->reset(true);
    }
}

/// A row's numbers, in nanoseconds where they are durations.
struct Numbers {
    std::string name;
    long long count, total, max, maxCount, min, suspendTotal, suspendMax;
};

int printRow(char* out, std::size_t size, Numbers const& n) {
    return std::snprintf(out, size, "%-40s%9lld%15lld%15lld%15lld%15lld%15lld%15lld%15lld  \n", n.name.c_str(), n.count,
                         n.total / 1000, n.total / 1000 / n.count, n.max / 1000, n.maxCount, n.min / 1000,
                         n.suspendTotal / 1000, n.suspendMax / 1000);
}

std::vector<Numbers> makeNumbers() {
    std::vector<Numbers> all;
    for (int i = 1; i <= TIMERS; ++i) {
        long long const unit = 1'234'567'890LL * (i % 7 + 1);
        all.push_back({nameOf(i), 3, 6 * unit, 3 * unit, 3, unit, 45'925'926, 22'962'963});
    }
    return all;
}

void reportBySnprintf(benchmark::State& state) {
    static std::vector<Numbers> const all = makeNumbers();
    for (auto _ : state) {
        state.PauseTiming();
        removeReports();
        state.ResumeTiming();
        File file((reports() / "peer").c_str(), 0x226, true);
        char row[512];
        for (Numbers const& numbers : all) {
            file->write(row, static_cast<std::uint64_t>(printRow(row, sizeof row, numbers)));
        }
    }
}

void row(benchmark::State& state) {
    PileTimer timer(nameOf(1234).c_str(), true);
    fill(timer, 3);
    BufStr<255> line;
    for (auto _ : state) {
        timer.print(line, 1'000'000);
        benchmark::DoNotOptimize(line.getBuf());
    }
}

void rowBySnprintf(benchmark::State& state) {
    static std::vector<Numbers> const all = makeNumbers();
    char line[512];
    for (auto _ : state) {
        printRow(line, sizeof line, all[2]);
        benchmark::DoNotOptimize(+line);
    }
}

BENCHMARK(report)->Name("report-10000/ours");
BENCHMARK(reportBySnprintf)->Name("report-10000/snprintf");
BENCHMARK(row)->Name("row/ours");
BENCHMARK(rowBySnprintf)->Name("row/snprintf");

} // namespace
