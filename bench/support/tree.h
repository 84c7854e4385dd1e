/// \file
/// Places, trees and other programs for benchmarks. Everything lies in memory (/dev/shm, where there is one), so that
/// no disk is measured.

#ifndef BENCH_SUPPORT_TREE_H
#define BENCH_SUPPORT_TREE_H

#include <benchmark/benchmark.h>

#include <chrono>
#include <filesystem>
#include <initializer_list>
#include <string>

/// The folder of this run, removed at its end.
class Workplace {
public:
    Workplace();
    ~Workplace();
    Workplace(Workplace const&) = delete;
    Workplace& operator=(Workplace const&) = delete;

    std::string operator/(std::string const& name) const { return path_ + "/" + name; }

private:
    std::string path_;
};

Workplace const& workplace();

inline constexpr int SOURCE_FOLDERS = 1'000;
inline constexpr int SOURCE_FILES = 20'000;

/// A tree of files of 0 to 16 KiB, eight folders to a folder. Made at the first call.
std::string const& sourceTree();

/// Runs a program to its end, its output and its errors thrown away.
/// \return whether it ended well
bool run(std::initializer_list<char const*> command);

/// Times `work` alone, between `before` and `after`.
template <class Before, class Work, class After>
void timed(benchmark::State& state, Before before, Work work, After after) {
    for (auto _ : state) {
        before();
        auto const begin = std::chrono::steady_clock::now();
        bool const good = work();
        state.SetIterationTime(std::chrono::duration<double>(std::chrono::steady_clock::now() - begin).count());
        if (!good) state.SkipWithError("failed");
        after();
    }
}

inline constexpr auto NOTHING = [] {};

/// Times `bool copy(to, from)` of the source tree, into a place that does not exist.
template <class Copy>
void copyTree(benchmark::State& state, Copy copy) {
    std::string const& from = sourceTree();
    std::string const to = workplace() / "copy";
    timed(
        state, NOTHING, [&] { return copy(to, from); }, [&] { std::filesystem::remove_all(to); });
}

#endif
