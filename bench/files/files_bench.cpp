// Status and open files beside the bare system calls.

#include "bench/support/tree.h"

#include <zor_basis/files/f_stat.h>
#include <zor_basis/files/file.h>

#include <benchmark/benchmark.h>

#include <cstdio>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

using namespace ZOR_Basis;

namespace {

namespace fs = std::filesystem;

constexpr std::size_t PIECE = 4096;
constexpr std::size_t PIECES = 64 * 1024 * 1024 / PIECE;
constexpr int LINES = 1'000'000;

std::string existing() {
    std::string const path = workplace() / "existing";
    std::ofstream(path) << "text";
    return path;
}

void statusOurs(benchmark::State& state, std::string const& path) {
    for (auto _ : state) {
        FStat entry(path.c_str());
        benchmark::DoNotOptimize(entry);
    }
}

/// A missing entry takes two calls: ours, and the one of the platform layer.
void statusSystem(benchmark::State& state, std::string const& path, int calls) {
    for (auto _ : state) {
        struct stat entry;
        for (int i = 0; i < calls; ++i) {
            int found = ::lstat(path.c_str(), &entry);
            benchmark::DoNotOptimize(found);
        }
        benchmark::DoNotOptimize(entry);
    }
}

BENCHMARK_CAPTURE(statusOurs, e, existing())->Name("status/existing/ours");
BENCHMARK_CAPTURE(statusSystem, e, existing(), 1)->Name("status/existing/system");
BENCHMARK_CAPTURE(statusOurs, m, workplace() / "missing")->Name("status/missing/ours");
BENCHMARK_CAPTURE(statusSystem, m, workplace() / "missing", 2)->Name("status/missing/system");

/// 64 MiB, whichever row comes first.
std::string stream() {
    std::string const path = workplace() / "stream";
    if (!fs::exists(path)) std::ofstream(path) << "";
    if (fs::file_size(path) != PIECES * PIECE) fs::resize_file(path, PIECES * PIECE);
    return path;
}

void writeOurs(benchmark::State& state) {
    std::string const path = stream();
    std::vector<char> const piece(PIECE, 'x');
    for (auto _ : state) {
        File file(path.c_str(), File::FILE_WRITE | File::FILE_TRUNC | File::FILE_BINARY);
        for (std::size_t i = 0; i < PIECES; ++i) {
            if (file->write(piece.data(), PIECE) != PIECE) state.SkipWithError("write");
        }
    }
}

void writeSystem(benchmark::State& state) {
    std::string const path = stream();
    std::vector<char> const piece(PIECE, 'x');
    for (auto _ : state) {
        int const file = ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600);
        for (std::size_t i = 0; i < PIECES; ++i) {
            if (::write(file, piece.data(), PIECE) != static_cast<ssize_t>(PIECE)) state.SkipWithError("write");
        }
        ::close(file);
    }
}

void readOurs(benchmark::State& state) {
    std::string const path = stream();
    std::vector<char> piece(PIECE);
    for (auto _ : state) {
        File file(path.c_str(), File::FILE_READ | File::FILE_BINARY);
        for (std::size_t i = 0; i < PIECES; ++i) {
            if (file->read(piece.data(), PIECE) != PIECE) state.SkipWithError("read");
        }
    }
}

void readSystem(benchmark::State& state) {
    std::string const path = stream();
    std::vector<char> piece(PIECE);
    for (auto _ : state) {
        int const file = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
        for (std::size_t i = 0; i < PIECES; ++i) {
            if (::read(file, piece.data(), PIECE) != static_cast<ssize_t>(PIECE)) state.SkipWithError("read");
        }
        ::close(file);
    }
}

BENCHMARK(writeOurs)->Name("stream/write/ours")->Unit(benchmark::kMillisecond);
BENCHMARK(writeSystem)->Name("stream/write/descriptor")->Unit(benchmark::kMillisecond);
BENCHMARK(readOurs)->Name("stream/read/ours")->Unit(benchmark::kMillisecond);
BENCHMARK(readSystem)->Name("stream/read/descriptor")->Unit(benchmark::kMillisecond);

std::string lines() {
    std::string const path = workplace() / "lines";
    if (fs::exists(path)) return path;
    std::ofstream file(path);
    for (int i = 0; i < LINES; ++i) file << "line " << i << std::string(static_cast<std::size_t>(i % 60), '.') << '\n';
    return path;
}

void linesOurs(benchmark::State& state) {
    std::string const path = lines();
    char line[256];
    for (auto _ : state) {
        File file(path.c_str(), File::FILE_READ | File::FILE_SEQUENTIAL);
        int count = 0;
        while (file->getline(line, sizeof line) != 0) ++count;
        if (count != LINES) state.SkipWithError("lines");
    }
}

void linesSystem(benchmark::State& state) {
    std::string const path = lines();
    char line[256];
    for (auto _ : state) {
        std::FILE* const file = std::fopen(path.c_str(), "r");
        int count = 0;
        while (std::fgets(line, sizeof line, file) != nullptr) ++count;
        std::fclose(file);
        if (count != LINES) state.SkipWithError("lines");
    }
}

BENCHMARK(linesOurs)->Name("lines/ours")->Unit(benchmark::kMillisecond);
BENCHMARK(linesSystem)->Name("lines/fgets")->Unit(benchmark::kMillisecond);

} // namespace
