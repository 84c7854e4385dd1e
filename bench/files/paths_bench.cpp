// Paths and wildcards beside strings that keep short text inside, the standard library's paths, and the C library's
// matching.

#include <zor_basis/files/f_path.h>

#include <benchmark/benchmark.h>

#include <filesystem>
#include <fnmatch.h>
#include <string>

#ifdef BENCH_HAS_LLVM
#include <llvm/ADT/SmallString.h>
#endif

using namespace ZOR_Basis;

namespace {

char const* parts[] = {"/srv/spool", "jobs", "2024-11", "page 0001.tif"};
char const* source = "\\srv\\spool//jobs\\2024-11//page 0001.tif";
char const* whole = "/srv/spool/jobs/2024-11/page 0001.tif";

void joinOurs(benchmark::State& state) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(parts);
        FPath path;
        for (char const* part : parts) path.add(part);
        benchmark::DoNotOptimize(path.c_str());
    }
}

void joinFilesystem(benchmark::State& state) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(parts);
        std::filesystem::path path;
        for (char const* part : parts) path /= part;
        benchmark::DoNotOptimize(path.c_str());
    }
}

void normaliseOurs(benchmark::State& state) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(source);
        FPath path;
        path.normalize(source, false);
        benchmark::DoNotOptimize(path.c_str());
    }
}

void normaliseFilesystem(benchmark::State& state) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(source);
        auto const path = std::filesystem::path(source).lexically_normal();
        benchmark::DoNotOptimize(path.c_str());
    }
}

void splitOurs(benchmark::State& state) {
    FPath const path(whole);
    for (auto _ : state) {
        benchmark::DoNotOptimize(path.c_str());
        FPath directory;
        FPath name;
        path.split(directory, name);
        benchmark::DoNotOptimize(directory.c_str());
        benchmark::DoNotOptimize(name.c_str());
    }
}

void splitFilesystem(benchmark::State& state) {
    std::filesystem::path const path(whole);
    for (auto _ : state) {
        benchmark::DoNotOptimize(path.c_str());
        auto const directory = path.parent_path();
        auto const name = path.filename();
        benchmark::DoNotOptimize(directory.c_str());
        benchmark::DoNotOptimize(name.c_str());
    }
}

#ifdef BENCH_HAS_LLVM
using Small = llvm::SmallString<255>;

void joinSmall(benchmark::State& state) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(parts);
        Small path;
        for (char const* part : parts) {
            if (!path.empty() && path.back() != '/') path.push_back('/');
            path.append(llvm::StringRef(part));
        }
        benchmark::DoNotOptimize(path.c_str());
    }
}

void normaliseSmall(benchmark::State& state) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(source);
        Small path;
        for (char const* at = source; *at != '\0'; ++at) {
            bool const slash = *at == '/' || *at == '\\';
            if (!slash) {
                path.push_back(*at);
            } else if (path.empty() || path.back() != '/') {
                path.push_back('/');
            }
        }
        benchmark::DoNotOptimize(path.c_str());
    }
}

void splitSmall(benchmark::State& state) {
    Small const path{llvm::StringRef(whole)};
    for (auto _ : state) {
        benchmark::DoNotOptimize(path.data());
        std::size_t const slash = llvm::StringRef(path).find_last_of("/\\");
        Small directory;
        Small name;
        directory.append(llvm::StringRef(path).take_front(slash));
        name.append(llvm::StringRef(path).drop_front(slash + 1));
        benchmark::DoNotOptimize(directory.c_str());
        benchmark::DoNotOptimize(name.c_str());
    }
}

BENCHMARK(joinSmall)->Name("path/join/SmallString");
BENCHMARK(normaliseSmall)->Name("path/normalise/SmallString");
BENCHMARK(splitSmall)->Name("path/split/SmallString");
#endif

BENCHMARK(joinOurs)->Name("path/join/ours");
BENCHMARK(joinFilesystem)->Name("path/join/filesystem");
BENCHMARK(normaliseOurs)->Name("path/normalise/ours");
BENCHMARK(normaliseFilesystem)->Name("path/normalise/filesystem");
BENCHMARK(splitOurs)->Name("path/split/ours");
BENCHMARK(splitFilesystem)->Name("path/split/filesystem");

struct Match {
    char const* row;
    char const* pattern;
    char const* name;
};

constexpr Match MATCHES[] = {
    {"extension", "*.tif", "page 0001 of the second job.tif"},
    {"literal", "page 0001 of the second job.tif", "page 0001 of the second job.tif"},
    {"mark", "page ???? of the second job.tif", "page 0001 of the second job.tif"},
    {"stars", "page*of*second*.t?f", "page 0001 of the second job.tif"},
    {"miss", "*.pdf", "page 0001 of the second job.tif"},
};

void matchOurs(benchmark::State& state, Match match) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(match.pattern);
        benchmark::DoNotOptimize(match.name);
        bool found = FPath::matchWildCard(match.pattern, match.name);
        benchmark::DoNotOptimize(found);
    }
}

void matchSystem(benchmark::State& state, Match match) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(match.pattern);
        benchmark::DoNotOptimize(match.name);
        int found = fnmatch(match.pattern, match.name, FNM_NOESCAPE);
        benchmark::DoNotOptimize(found);
    }
}

/// Stands still for a microsecond of its own clock: a limit that is a time.
void microsecond(benchmark::State& state) {
    for (auto _ : state) state.SetIterationTime(1e-6);
}

std::string const letters(1024, 'a');
[[maybe_unused]] bool const registered = [] {
    for (Match const& match : MATCHES) {
        std::string const row = std::string("wildcard/") + match.row;
        benchmark::RegisterBenchmark((row + "/ours").c_str(), matchOurs, match);
        benchmark::RegisterBenchmark((row + "/fnmatch").c_str(), matchSystem, match);
    }
    Match const many{"many-stars", "*a*a*a*a*b", letters.c_str()};
    benchmark::RegisterBenchmark("wildcard/many-stars/ours", matchOurs, many);
    benchmark::RegisterBenchmark("wildcard/many-stars/microsecond", microsecond)->UseManualTime()->Iterations(1000);
    return true;
}();

} // namespace
