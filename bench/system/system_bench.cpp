// Processes, lines of a text and folders for jobs beside what the system does for them at least.

#include "bench/support/scratch_root.h"

#include <zor_basis/files/f_path.h>
#include <zor_basis/system.h>

#include <benchmark/benchmark.h>

#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <random>
#include <spawn.h>
#include <string>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace fs = std::filesystem;
using namespace ZOR_Basis;

namespace {

ScratchRoot const root("tmp");

/* A child */

void create(benchmark::State& state) {
    for (auto _ : state) {
        int code = -1;
        if (!Process::Create("/bin/true", nullptr, "true", &code) || code != 0) std::abort();
    }
}

void spawn(benchmark::State& state) {
    char name[] = "true";
    char* const words[] = {name, nullptr};
    for (auto _ : state) {
        pid_t child = 0;
        int status = -1;
        if (posix_spawn(&child, "/bin/true", nullptr, nullptr, words, environ) != 0) std::abort();
        if (waitpid(child, &status, 0) != child || status != 0) std::abort();
    }
}

BENCHMARK(create)->Name("process-true/ours")->UseRealTime();
BENCHMARK(spawn)->Name("process-true/posix-spawn")->UseRealTime();

/* Lines */

constexpr std::size_t TEXT_SIZE = 64 << 20;
constexpr int LONGEST = 255;

/// Lines of 20 to 140 bytes.
std::string const& text() {
    static std::string const made = [] {
        std::string lines;
        lines.reserve(TEXT_SIZE);
        std::mt19937 random(1);
        while (lines.size() < TEXT_SIZE) {
            lines.append(20 + random() % 121, static_cast<char>('a' + random() % 26));
            lines += '\n';
        }
        lines.resize(TEXT_SIZE - 1);
        return lines += '\n';
    }();
    return made;
}

void getLine(benchmark::State& state) {
    std::string const& all = text();
    for (auto _ : state) {
        ZB_Parse parse(all.data(), static_cast<int>(all.size()));
        char line[LONGEST + 1];
        int length = 0;
        std::size_t sum = 0;
        while (parse.getLine(LONGEST, line, &length)) {
            benchmark::DoNotOptimize(+line);
            sum += static_cast<std::size_t>(length) + 1;
        }
        if (sum != all.size()) std::abort();
    }
}

void memchrLines(benchmark::State& state) {
    std::string const& all = text();
    for (auto _ : state) {
        char line[LONGEST + 1];
        char const* at = all.data();
        char const* const end = at + all.size();
        while (at != end) {
            auto const* const lineEnd =
                static_cast<char const*>(std::memchr(at, '\n', static_cast<std::size_t>(end - at)));
            if (lineEnd == nullptr) std::abort();
            auto const length = static_cast<std::size_t>(lineEnd - at);
            std::memcpy(line, at, length);
            line[length] = '\0';
            benchmark::DoNotOptimize(+line);
            at = lineEnd + 1;
        }
    }
}

BENCHMARK(getLine)->Name("lines-64m/ours")->Unit(benchmark::kMillisecond);
BENCHMARK(memchrLines)->Name("lines-64m/memchr")->Unit(benchmark::kMillisecond);

/* A folder for a job */

void tempDir(benchmark::State& state) {
    for (auto _ : state) {
        VDPTempDir const folder;
        benchmark::DoNotOptimize(folder.path().c_str());
    }
}

/// Looks at the name, which is free, and at the folder above; makes the folder; looks whether it is there still, and
/// removes it.
void systemCalls(benchmark::State& state) {
    std::string const above = workplace() / "tmp";
    std::uint64_t number = 0;
    struct stat status;
    for (auto _ : state) {
        std::string const path = above + "/" + std::to_string(++number) + ".peer";
        if (lstat(path.c_str(), &status) == 0 || lstat(above.c_str(), &status) != 0) std::abort();
        if (mkdir(path.c_str(), 0777) != 0 || lstat(path.c_str(), &status) != 0) std::abort();
        if (rmdir(path.c_str()) != 0) std::abort();
    }
}

BENCHMARK(tempDir)->Name("temp-dir/ours");
BENCHMARK(systemCalls)->Name("temp-dir/system-calls");

} // namespace
