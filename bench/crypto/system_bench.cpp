// Queries of the system beside the bare look-ups that answer them.

#include <zor_basis/system.h>

#include <benchmark/benchmark.h>

#include <mntent.h>
#include <pwd.h>
#include <unistd.h>

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <string>

using namespace ZOR_Basis;

namespace {

constexpr char PATH[] = "/usr/share/doc";

void currentUser(benchmark::State& state) {
    BufStr<15> user;
    for (auto _ : state) {
        Sys::CurrentUser(user, false);
        benchmark::DoNotOptimize(user.getBuf());
    }
}

void currentUserBare(benchmark::State& state) {
    passwd record;
    passwd* found;
    char buffer[1024];
    for (auto _ : state) {
        getpwuid_r(geteuid(), &record, buffer, sizeof buffer, &found);
        benchmark::DoNotOptimize(found);
    }
}

void isLocalDisk(benchmark::State& state) {
    for (auto _ : state) {
        bool local = Sys::isLocalDisk(PATH);
        benchmark::DoNotOptimize(local);
    }
}

/// The kind of file system of the longest directory in the mount table that leads to the path.
std::string kindOf(char const* path) {
    std::string kind;
    std::size_t longest = 0;
    char* const real = realpath(path, nullptr);
    std::FILE* const table = setmntent("/proc/self/mounts", "re");
    mntent entry;
    char line[8192];
    while (getmntent_r(table, &entry, line, sizeof line) != nullptr) {
        std::size_t const n = std::strlen(entry.mnt_dir);
        if (n < longest || std::strncmp(entry.mnt_dir, real, n) != 0) continue;
        longest = n;
        kind = entry.mnt_type;
    }
    endmntent(table);
    std::free(real);
    return kind;
}

void isLocalDiskBare(benchmark::State& state) {
    for (auto _ : state) {
        bool local = kindOf(PATH) == "ext4";
        benchmark::DoNotOptimize(local);
    }
}

BENCHMARK(currentUser)->Name("current-user/ours");
BENCHMARK(currentUserBare)->Name("current-user/look-up");
BENCHMARK(isLocalDisk)->Name("is-local-disk/ours");
BENCHMARK(isLocalDiskBare)->Name("is-local-disk/look-up");

} // namespace
