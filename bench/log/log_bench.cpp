// What a caller pays for a line of a log, beside a logger that writes to its file on the caller's thread. Ours are
// written out between the measurements, by the alert; what that costs its thread is in a row of its own. All rows are
// of 1,000 lines.

#include "bench/support/scratch_root.h"

#include "basis/platform/hq_basis.h"

#include <zor_basis/log.h>

#include <benchmark/benchmark.h>

#include <array>
#include <barrier>
#include <chrono>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <random>
#include <string>
#include <unistd.h>

#ifdef BENCH_HAS_SPDLOG
#include <spdlog/sinks/basic_file_sink.h>
#include <spdlog/spdlog.h>
#endif

namespace fs = std::filesystem;
using namespace ZOR_Basis;

namespace {

constexpr int LINES = 1000;
constexpr std::size_t VALUES = 1024;

ScratchRoot const root("tmp");

/// With them "%s %d %.3f" makes about 80 bytes.
struct Values {
    std::array<int, VALUES> numbers;
    std::array<double, VALUES> seconds;
    char const* text = "a text of the length that texts in a log usually have, of a page";

    Values() {
        std::mt19937 random(7);
        for (int& number : numbers) number = static_cast<int>(random() % 100'000);
        for (double& second : seconds) second = static_cast<double>(random()) / 4e8;
    }
};

Values const values;

/* Loggers */

class Ours {
public:
    Ours() : log_("bench") {
        // The newest alert is the log's.
        std::uint32_t const next = HQ_Basis::AlertTimer::New(
            1'000'000, [](HQ_Basis::AlertTimer::Alert const&) { return std::uint32_t{1'000'000}; }, nullptr);
        alert_ = next - 1;
        HQ_Basis::AlertTimer::Delete(next);
    }
    void line(std::size_t i) { log_.out("%s %d %.3f", values.text, values.numbers[i], values.seconds[i]); }
    void textAndNumber(std::size_t i) { log_.out("%s %d", values.text, values.numbers[i]); }
    /// All but the last block, and the file does not grow for ever.
    void writeOut() {
        xos_HostAlertFire(alert_);
        fs::resize_file(file(), 0);
    }
    static fs::path file() { return workplace() / "tmp/zb_log/bench/0.log"; }

private:
    Log log_;
    std::uint32_t alert_;
};

template <class Logger>
Logger& instance() {
    // Never destroyed: a closed log keeps a thread busy.
    static auto& logger = *new Logger;
    return logger;
}

#ifdef BENCH_HAS_SPDLOG
template <class Sink>
class Spdlog {
public:
    Spdlog() : logger_("bench", std::make_shared<Sink>(file().string(), true)) { logger_.set_pattern("%v"); }
    void line(std::size_t i) { logger_.info("{} {} {:.3f}", values.text, values.numbers[i], values.seconds[i]); }
    void textAndNumber(std::size_t i) { logger_.info("{} {}", values.text, values.numbers[i]); }
    void writeOut() {
        logger_.flush();
        fs::resize_file(file(), 0);
    }
    static fs::path file() { return workplace() / "spdlog.log"; }

private:
    spdlog::logger logger_;
};
using SpdlogOne = Spdlog<spdlog::sinks::basic_file_sink_st>;
using SpdlogMany = Spdlog<spdlog::sinks::basic_file_sink_mt>;
#endif

/* Rows */

enum class Format { LINE, TEXT_AND_NUMBER };

template <class Logger, Format FORMAT>
void writeLines(Logger& logger) {
    for (int i = 0; i < LINES; ++i) {
        std::size_t const at = static_cast<std::size_t>(i) % VALUES;
        if constexpr (FORMAT == Format::LINE) {
            logger.line(at);
        } else {
            logger.textAndNumber(at);
        }
    }
}

double secondsSince(std::chrono::steady_clock::time_point start) {
    return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
}

/// The threads write at the same time, and nobody does while lines are written out.
template <class Logger, Format FORMAT, int THREADS>
void lines(benchmark::State& state) {
    static std::barrier together(THREADS);
    auto& logger = instance<Logger>();
    for (auto _ : state) {
        together.arrive_and_wait();
        auto const start = std::chrono::steady_clock::now();
        writeLines<Logger, FORMAT>(logger);
        state.SetIterationTime(secondsSince(start));
        together.arrive_and_wait();
        if (state.thread_index() == 0) logger.writeOut();
    }
}

template <class Logger>
void linesAndFile(benchmark::State& state) {
    auto& logger = instance<Logger>();
    for (auto _ : state) {
        auto const start = std::chrono::steady_clock::now();
        writeLines<Logger, Format::LINE>(logger);
        logger.writeOut();
        state.SetIterationTime(secondsSince(start));
    }
}

BENCHMARK(lines<Ours, Format::LINE, 1>)->Name("line-one-thread/ours")->UseManualTime();
BENCHMARK(lines<Ours, Format::LINE, 2>)->Name("line-two-threads/ours")->Threads(2)->UseManualTime();
BENCHMARK(lines<Ours, Format::TEXT_AND_NUMBER, 1>)->Name("text-and-number-one-thread/ours")->UseManualTime();
BENCHMARK(lines<Ours, Format::TEXT_AND_NUMBER, 2>)
    ->Name("text-and-number-two-threads/ours")
    ->Threads(2)
    ->UseManualTime();
BENCHMARK(linesAndFile<Ours>)->Name("line-and-its-way-to-the-file/ours")->UseManualTime();
#ifdef BENCH_HAS_SPDLOG
BENCHMARK(lines<SpdlogOne, Format::LINE, 1>)->Name("line-one-thread/spdlog")->UseManualTime();
BENCHMARK(lines<SpdlogMany, Format::LINE, 2>)->Name("line-two-threads/spdlog")->Threads(2)->UseManualTime();
BENCHMARK(lines<SpdlogOne, Format::TEXT_AND_NUMBER, 1>)->Name("text-and-number-one-thread/spdlog")->UseManualTime();
BENCHMARK(lines<SpdlogMany, Format::TEXT_AND_NUMBER, 2>)
    ->Name("text-and-number-two-threads/spdlog")
    ->Threads(2)
    ->UseManualTime();
BENCHMARK(linesAndFile<SpdlogOne>)->Name("line-and-its-way-to-the-file/spdlog")->UseManualTime();
#endif

} // namespace
