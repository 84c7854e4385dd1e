// Walks, searches and the whole job beside the standard library, the C library's walkers and the system's own programs.

#include "bench/support/tree.h"

#include <zor_basis/files.h>
#include <zor_basis/walk.h>

#include <benchmark/benchmark.h>

#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <fts.h>
#include <ftw.h>
#include <iterator>

using namespace ZOR_Basis;
namespace fs = std::filesystem;

namespace {

constexpr std::uint64_t ENTRIES = SOURCE_FILES + SOURCE_FOLDERS - 1;
constexpr char PATTERN[] = "document-1*7.txt";

void expect(benchmark::State& state, bool good) {
    if (!good) state.SkipWithError("wrong result");
}

// ---- a deep walk with the status of every entry -------------------------------------------------------------------

struct Sizes : FileVisitor {
    bool perform(FileEntry* entry) override {
        bytes += entry->getSize();
        ++entries;
        return true;
    }
    std::uint64_t bytes = 0;
    std::uint64_t entries = 0;
};

void walkOurs(benchmark::State& state) {
    Str const top(sourceTree());
    for (auto _ : state) {
        Sizes sizes;
        FileIterator::doIt(top, LOOK_BOTH, &sizes, nullptr, nullptr, true, false, false);
        expect(state, sizes.entries == ENTRIES);
    }
}

void walkFilesystem(benchmark::State& state) {
    for (auto _ : state) {
        std::uint64_t bytes = 0;
        std::uint64_t entries = 0;
        for (fs::directory_entry const& entry : fs::recursive_directory_iterator(sourceTree())) {
            if (entry.is_regular_file()) bytes += entry.file_size();
            benchmark::DoNotOptimize(entry.last_write_time());
            ++entries;
        }
        benchmark::DoNotOptimize(bytes);
        expect(state, entries == ENTRIES);
    }
}

std::uint64_t seen = 0;

void walkNftw(benchmark::State& state) {
    for (auto _ : state) {
        seen = 0;
        ::nftw(
            sourceTree().c_str(), [](char const*, struct stat const*, int, FTW*) { return ++seen, 0; }, 64, FTW_PHYS);
        expect(state, seen == ENTRIES + 1);
    }
}

void walkFts(benchmark::State& state) {
    for (auto _ : state) {
        char* const tops[] = {const_cast<char*>(sourceTree().c_str()), nullptr};
        FTS* const walk = ::fts_open(tops, FTS_PHYSICAL | FTS_NOCHDIR, nullptr);
        std::uint64_t entries = 0;
        while (FTSENT const* entry = ::fts_read(walk)) entries += entry->fts_info != FTS_DP ? 1 : 0;
        ::fts_close(walk);
        expect(state, entries == ENTRIES + 1);
    }
}

// ---- searches -------------------------------------------------------------------------------------------------------

void findOurs(benchmark::State& state) {
    FPath found;
    for (auto _ : state) expect(state, zbFindFile(Str(sourceTree()), PATTERN, LOOK_FILES, found, false, true) > 0);
}
void findProgram(benchmark::State& state) {
    for (auto _ : state) expect(state, run({"find", sourceTree().c_str(), "-name", PATTERN}));
}

void countOurs(benchmark::State& state) {
    for (auto _ : state) expect(state, FileCountVisitor::Get(Str(sourceTree()), LOOK_BOTH, 0) > 0);
}
void countFilesystem(benchmark::State& state) {
    for (auto _ : state) {
        int entries = 0;
        for (fs::directory_entry const& entry : fs::directory_iterator(sourceTree())) {
            benchmark::DoNotOptimize(entry.is_regular_file() ? entry.file_size() : 0);
            benchmark::DoNotOptimize(entry.last_write_time());
            ++entries;
        }
        expect(state, entries > 0);
    }
}

void sizeOurs(benchmark::State& state) {
    for (auto _ : state) expect(state, FileSizeVisitor::Get(Str(sourceTree()), true) > 0);
}
void sizeProgram(benchmark::State& state) {
    for (auto _ : state) expect(state, run({"du", "-s", "--apparent-size", sourceTree().c_str()}));
}
void sizeProcess(benchmark::State& state) {
    for (auto _ : state) expect(state, run({TREE_SIZE_PROGRAM, sourceTree().c_str()}));
}

// ---- the whole job --------------------------------------------------------------------------------------------------

bool copyOurs(std::string const& to, std::string const& from) {
    FileCopyVisitor copier(Str(to), true, true);
    return Dir::New(to.c_str(), false) &&
           FileIterator::doIt(Str(from), LOOK_BOTH, &copier, nullptr, nullptr, false, true, false);
}

void jobCopyOurs(benchmark::State& state) { copyTree(state, copyOurs); }
void jobCopyFilesystem(benchmark::State& state) {
    copyTree(state, [](std::string const& to, std::string const& from) {
        std::error_code error;
        fs::copy(from, to, fs::copy_options::recursive, error);
        return !error;
    });
}
void jobCopyProgram(benchmark::State& state) {
    copyTree(state, [](std::string const& to, std::string const& from) {
        return run({"cp", "-r", from.c_str(), to.c_str()});
    });
}

bool sameFile(std::string const& a, std::string const& b) {
    std::ifstream first(a, std::ios::binary);
    std::ifstream second(b, std::ios::binary);
    using Bytes = std::istreambuf_iterator<char>;
    return first && second && std::string(Bytes(first), {}) == std::string(Bytes(second), {});
}

/// Compares every file of the source with its copy.
struct Verifier : FileVisitor {
    bool perform(FileEntry* entry) override {
        std::string const path = entry->getFullPath().c_str();
        return sameFile(path, (workplace() / "copy") + path.substr(sourceTree().size()));
    }
};

void jobVerifyOurs(benchmark::State& state) {
    copyOurs(workplace() / "copy", sourceTree());
    for (auto _ : state) {
        Verifier verifier;
        expect(state,
               FileIterator::doIt(Str(sourceTree()), LOOK_FILES, &verifier, nullptr, nullptr, true, true, false));
    }
    fs::remove_all(workplace() / "copy");
}
void jobVerifyProgram(benchmark::State& state) {
    std::string const copy = workplace() / "copy";
    copyOurs(copy, sourceTree());
    for (auto _ : state) expect(state, run({"diff", "-r", sourceTree().c_str(), copy.c_str()}));
    fs::remove_all(copy);
}

template <class Remove>
void removeTree(benchmark::State& state, Remove remove) {
    std::string const victim = workplace() / "victim";
    timed(
        state, [&] { copyOurs(victim, sourceTree()); }, [&] { return remove(victim); }, NOTHING);
}

void jobRemoveOurs(benchmark::State& state) {
    removeTree(state, [](std::string const& path) {
        FileDeleteVisitor remover;
        return FileIterator::doIt(Str(path), LOOK_BOTH, &remover, nullptr, nullptr, false, true, false) &&
               Dir::Rem(path.c_str(), true, false);
    });
}
void jobRemoveProgram(benchmark::State& state) {
    removeTree(state, [](std::string const& path) { return run({"rm", "-rf", path.c_str()}); });
}

} // namespace

BENCHMARK(walkOurs)->Name("walk_status/ours")->UseRealTime();
BENCHMARK(walkFilesystem)->Name("walk_status/filesystem")->UseRealTime();
BENCHMARK(walkNftw)->Name("walk_status/nftw")->UseRealTime();
BENCHMARK(walkFts)->Name("walk_status/fts")->UseRealTime();
BENCHMARK(findOurs)->Name("find_wildcard/ours")->UseRealTime();
BENCHMARK(findProgram)->Name("find_wildcard/find")->UseRealTime();
BENCHMARK(countOurs)->Name("count_folder/ours")->UseRealTime();
BENCHMARK(countFilesystem)->Name("count_folder/filesystem")->UseRealTime();
BENCHMARK(sizeOurs)->Name("tree_size/ours")->UseRealTime();
BENCHMARK(sizeProgram)->Name("tree_size/du")->UseRealTime();
BENCHMARK(sizeProcess)->Name("tree_size_process/ours")->UseRealTime();
BENCHMARK(sizeProgram)->Name("tree_size_process/du")->UseRealTime();
BENCHMARK(jobCopyOurs)->Name("job_copy/ours")->UseManualTime()->Iterations(1);
BENCHMARK(jobCopyFilesystem)->Name("job_copy/filesystem")->UseManualTime()->Iterations(1);
BENCHMARK(jobCopyProgram)->Name("job_copy/cp")->UseManualTime()->Iterations(1);
BENCHMARK(jobVerifyOurs)->Name("job_verify/ours")->UseRealTime()->Iterations(1);
BENCHMARK(jobVerifyProgram)->Name("job_verify/diff")->UseRealTime()->Iterations(1);
BENCHMARK(jobRemoveOurs)->Name("job_remove/ours")->UseManualTime()->Iterations(1);
BENCHMARK(jobRemoveProgram)->Name("job_remove/rm")->UseManualTime()->Iterations(1);
