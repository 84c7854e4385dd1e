// Files and trees of the stand-alone platform layer beside raw system calls, the standard library and the system's own
// programs.

#include "basis/platform/xos_basics.h"
#include "bench/support/tree.h"

#include <benchmark/benchmark.h>

#include <cstdio>
#include <dirent.h>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <memory>
#include <random>
#include <string>
#include <unistd.h>

namespace {

namespace fs = std::filesystem;

// Trees

void copyByHost(benchmark::State& state) {
    copyTree(state, [](std::string const& to, std::string const& from) {
        return xos_DirCopy(to.c_str(), from.c_str(), 0x200) == 0;
    });
}
void copyByStandardLibrary(benchmark::State& state) {
    copyTree(state, [](std::string const& to, std::string const& from) {
        std::error_code error;
        fs::copy(from, to, fs::copy_options::recursive, error);
        return !error;
    });
}
void copyByProgram(benchmark::State& state) {
    copyTree(state, [](std::string const& to, std::string const& from) {
        return run({"cp", "-r", from.c_str(), to.c_str()});
    });
}

template <class Remove>
void removeTree(benchmark::State& state, Remove remove) {
    std::string const from = sourceTree();
    std::string const victim = workplace() / "victim";
    timed(
        state, [&] { xos_DirCopy(victim.c_str(), from.c_str(), 0x200); }, [&] { return remove(victim.c_str()); },
        NOTHING);
}

void removeByHost(benchmark::State& state) {
    removeTree(state, [](char const* path) { return xos_DirRemove(path, 0x600) == 0; });
}
void removeByProgram(benchmark::State& state) {
    removeTree(state, [](char const* path) { return run({"rm", "-rf", path}); });
}

/// The directories of the tree, which takes the kind of every entry.
int directoriesByHost(std::string const& path) {
    int count = 1;
    xos_Dir const listing = xos_DirOpenEx(path.c_str(), nullptr, 0);
    while (char const* const name = xos_DirNextEx(listing, 1, 0, 0x4000)) {
        count += directoriesByHost(path + "/" + name);
    }
    xos_DirClose(listing);
    return count;
}

int directoriesBySystemCalls(int at, char const* name) {
    constexpr std::size_t SIZE = 32 * 1024;
    int const directory = ::openat(at, name, O_RDONLY | O_DIRECTORY | O_CLOEXEC);
    auto const buffer = std::make_unique_for_overwrite<char[]>(SIZE);
    int count = 1;
    for (ssize_t got = 0; (got = ::getdents64(directory, buffer.get(), SIZE)) > 0;) {
        for (ssize_t offset = 0; offset < got;) {
            auto const* const entry = reinterpret_cast<dirent64 const*>(buffer.get() + offset);
            offset += entry->d_reclen;
            std::string_view const entryName{entry->d_name};
            if (entry->d_type == DT_DIR && entryName != "." && entryName != "..") {
                count += directoriesBySystemCalls(directory, entry->d_name);
            }
        }
    }
    ::close(directory);
    return count;
}

void listByHost(benchmark::State& state) {
    std::string const& top = sourceTree();
    for (auto _ : state) {
        if (directoriesByHost(top) != SOURCE_FOLDERS) state.SkipWithError("failed");
    }
}
void listBySystemCalls(benchmark::State& state) {
    std::string const& top = sourceTree();
    for (auto _ : state) {
        if (directoriesBySystemCalls(AT_FDCWD, top.c_str()) != SOURCE_FOLDERS) state.SkipWithError("failed");
    }
}

// Open files

constexpr std::size_t PIECE = 4096;
constexpr std::size_t PIECES = 64 * 1024 * 1024 / PIECE;

bool writeByHost(std::string const& path) {
    static char const piece[PIECE] = {};
    xos_File const file = xos_FileOpen(path.c_str(), 0x15);
    std::uint64_t sum = 0;
    for (std::size_t i = 0; i < PIECES; ++i) { sum += xos_FileWriteEx(file, piece, PIECE, 0, 0); }
    return xos_FileCloseEx(file, 0) == 0 && sum == PIECE * PIECES;
}

bool writeByDescriptor(std::string const& path) {
    static char const piece[PIECE] = {};
    int const file = ::open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0666);
    std::size_t sum = 0;
    for (std::size_t i = 0; i < PIECES; ++i) { sum += static_cast<std::size_t>(::write(file, piece, PIECE)); }
    return ::close(file) == 0 && sum == PIECE * PIECES;
}

bool readByHost(std::string const& path) {
    char piece[PIECE];
    xos_File const file = xos_FileOpen(path.c_str(), 0x02);
    std::uint64_t sum = 0;
    while (std::uint64_t const got = xos_FileReadEx(file, piece, PIECE, 0, 0)) { sum += got; }
    return xos_FileCloseEx(file, 0) == 0 && sum == PIECE * PIECES;
}

bool readByDescriptor(std::string const& path) {
    char piece[PIECE];
    int const file = ::open(path.c_str(), O_RDONLY | O_CLOEXEC);
    std::size_t sum = 0;
    for (ssize_t got = 0; (got = ::read(file, piece, PIECE)) > 0;) { sum += static_cast<std::size_t>(got); }
    return ::close(file) == 0 && sum == PIECE * PIECES;
}

void writePieces(benchmark::State& state, bool (*write)(std::string const&)) {
    std::string const path = workplace() / "written";
    timed(
        state, NOTHING, [&] { return write(path); }, [&] { ::unlink(path.c_str()); });
}

void readPieces(benchmark::State& state, bool (*read)(std::string const&)) {
    static std::string const path = [] {
        std::string made = workplace() / "read";
        writeByDescriptor(made);
        return made;
    }();
    timed(
        state, NOTHING, [&] { return read(path); }, NOTHING);
}

constexpr int LINES = 1'000'000;

std::string const& lineFile() {
    static std::string const path = [] {
        std::string made = workplace() / "lines";
        std::ofstream file{made, std::ios::binary};
        std::mt19937 random{3};
        for (int i = 0; i < LINES; ++i) { file << std::string(random() % 70, 'a') << '\n'; }
        return made;
    }();
    return path;
}

bool getsByHost(std::string const& path) {
    char line[256];
    xos_File const file = xos_FileOpen(path.c_str(), 0x02);
    int lines = 0;
    while (xos_FileGetsEx(file, line, sizeof line, 0) != nullptr) { ++lines; }
    return xos_FileCloseEx(file, 0) == 0 && lines == LINES;
}

bool getsByStream(std::string const& path) {
    char line[256];
    std::FILE* const file = std::fopen(path.c_str(), "rb");
    int lines = 0;
    while (std::fgets(line, sizeof line, file) != nullptr) { ++lines; }
    return std::fclose(file) == 0 && lines == LINES;
}

void getLines(benchmark::State& state, bool (*gets)(std::string const&)) {
    std::string const& path = lineFile();
    timed(
        state, NOTHING, [&] { return gets(path); }, NOTHING);
}

} // namespace

BENCHMARK(copyByHost)->Name("tree_copy/ours")->UseManualTime()->Iterations(1);
BENCHMARK(copyByStandardLibrary)->Name("tree_copy/filesystem")->UseManualTime()->Iterations(1);
BENCHMARK(copyByProgram)->Name("tree_copy/cp")->UseManualTime()->Iterations(1);
BENCHMARK(removeByHost)->Name("tree_remove/ours")->UseManualTime()->Iterations(1);
BENCHMARK(removeByProgram)->Name("tree_remove/rm")->UseManualTime()->Iterations(1);
BENCHMARK(listByHost)->Name("tree_list/ours")->UseRealTime();
BENCHMARK(listBySystemCalls)->Name("tree_list/getdents")->UseRealTime();
BENCHMARK_CAPTURE(writePieces, ours, writeByHost)->Name("write_64MiB/ours")->UseManualTime();
BENCHMARK_CAPTURE(writePieces, descriptor, writeByDescriptor)->Name("write_64MiB/descriptor")->UseManualTime();
BENCHMARK_CAPTURE(readPieces, ours, readByHost)->Name("read_64MiB/ours")->UseManualTime();
BENCHMARK_CAPTURE(readPieces, descriptor, readByDescriptor)->Name("read_64MiB/descriptor")->UseManualTime();
BENCHMARK_CAPTURE(getLines, ours, getsByHost)->Name("gets_1000000/ours")->UseManualTime();
BENCHMARK_CAPTURE(getLines, stream, getsByStream)->Name("gets_1000000/fgets")->UseManualTime();
