// Dictionaries and blobs beside what one would write with the standard library.

#include <zor_basis/containers/dict.h>
#include <zor_basis/files/i_file.h>
#include <zor_basis/text/blob.h>

#include "bench/files/tape.h"

#include <benchmark/benchmark.h>

#include <filesystem>
#include <fstream>
#include <memory>
#include <string>
#include <unistd.h>
#include <unordered_map>
#include <vector>

using namespace ZOR_Basis;

namespace {

namespace fs = std::filesystem;

using BlobDict = Dict<Blob, Blob>;
using Map = std::unordered_map<std::string, std::string>;

std::string dictPath() {
    fs::path const base = fs::exists("/dev/shm") ? fs::path{"/dev/shm"} : fs::temp_directory_path();
    return (base / ("bench-dict-" + std::to_string(::getpid()))).string();
}

struct RemovedAtEnd {
    ~RemovedAtEnd() {
        std::error_code ignored;
        fs::remove(dictPath(), ignored);
    }
} const removedAtEnd;

std::string keyOf(std::int64_t i) { return "setting." + std::to_string(i * 7919 % 100'003); }
std::string valueOf(std::int64_t i) { return "value " + std::to_string(i); }

void fill(Map& map, std::int64_t count) {
    for (std::int64_t i = 0; i < count; ++i) map[keyOf(i)] = valueOf(i);
}

void writeField(std::ofstream& file, std::string const& text) {
    std::uint32_t const n = static_cast<std::uint32_t>(text.size());
    file.write(reinterpret_cast<char const*>(&n), sizeof n);
    file.write(text.data(), n);
}

bool readField(std::ifstream& file, std::string& text) {
    std::uint32_t n = 0;
    if (!file.read(reinterpret_cast<char*>(&n), sizeof n)) return false;
    text.resize(n);
    return static_cast<bool>(file.read(text.data(), n));
}

void saveMap(Map const& map) {
    std::ofstream file(dictPath(), std::ios::binary | std::ios::trunc);
    for (auto const& [key, value] : map) {
        writeField(file, key);
        writeField(file, value);
    }
}

Map loadMap() {
    std::ifstream file(dictPath(), std::ios::binary);
    Map loaded;
    std::string key;
    std::string value;
    while (readField(file, key) && readField(file, value)) loaded[key] = value;
    return loaded;
}

template <std::int64_t COUNT>
void saveOurs(benchmark::State& state) {
    Map map;
    fill(map, COUNT);
    saveMap(map);
    std::string const path = dictPath();
    BlobDict dict{Str(path)};
    std::uint64_t change = 0;
    for (auto _ : state) {
        // Another value for the first key: without a change nothing is written.
        ++change;
        dict.set(dict.first()->value.key, Blob(8, reinterpret_cast<char const*>(&change)));
        if (!dict.write()) state.SkipWithError("write");
    }
}

template <std::int64_t COUNT>
void saveStandard(benchmark::State& state) {
    Map map;
    fill(map, COUNT);
    std::uint64_t change = 0;
    for (auto _ : state) {
        ++change;
        map.begin()->second.assign(reinterpret_cast<char const*>(&change), 8);
        saveMap(map);
    }
}

template <std::int64_t COUNT>
void loadOurs(benchmark::State& state) {
    Map map;
    fill(map, COUNT);
    saveMap(map);
    std::string const path = dictPath();
    for (auto _ : state) {
        BlobDict dict{Str(path)};
        if (dict.size() != map.size()) state.SkipWithError("read");
    }
}

template <std::int64_t COUNT>
void loadStandard(benchmark::State& state) {
    Map map;
    fill(map, COUNT);
    saveMap(map);
    for (auto _ : state) {
        if (loadMap().size() != map.size()) state.SkipWithError("read");
    }
}

constexpr std::int64_t GETS = 100;
/// Odd, so that the keys asked for are spread over the whole file.
constexpr std::int64_t GET_STEP = 97;

template <std::int64_t COUNT>
void loadAndGetOurs(benchmark::State& state) {
    Map map;
    fill(map, COUNT);
    saveMap(map);
    std::string const path = dictPath();
    for (auto _ : state) {
        BlobDict dict{Str(path)};
        Blob value;
        for (std::int64_t i = 0; i < GETS; ++i) {
            std::string const key = keyOf(i * GET_STEP);
            if (!dict.get(Blob(key.size(), key.data()), value)) state.SkipWithError("get");
        }
    }
}

template <std::int64_t COUNT>
void loadAndGetStandard(benchmark::State& state) {
    Map map;
    fill(map, COUNT);
    saveMap(map);
    for (auto _ : state) {
        Map const loaded = loadMap();
        std::string value;
        for (std::int64_t i = 0; i < GETS; ++i) {
            auto const found = loaded.find(keyOf(i * GET_STEP));
            if (found == loaded.end()) return state.SkipWithError("get");
            value = found->second;
        }
    }
}

template <std::int64_t COUNT>
void setAndSaveOurs(benchmark::State& state) {
    std::string const path = dictPath();
    for (auto _ : state) {
        BlobDict dict;
        dict.setPath(Str(path));
        for (std::int64_t i = 0; i < COUNT; ++i) {
            std::string const key = keyOf(i);
            std::string const value = valueOf(i);
            dict.set(Blob(key.size(), key.data()), Blob(value.size(), value.data()));
        }
        if (!dict.save()) state.SkipWithError("save");
    }
}

template <std::int64_t COUNT>
void setAndSaveStandard(benchmark::State& state) {
    for (auto _ : state) {
        Map map;
        fill(map, COUNT);
        saveMap(map);
    }
}

BENCHMARK(saveOurs<1'000>)->Name("dict/save/1000-records/ours");
BENCHMARK(saveStandard<1'000>)->Name("dict/save/1000-records/unordered_map");
BENCHMARK(saveOurs<10'000>)->Name("dict/save/10000-records/ours");
BENCHMARK(saveStandard<10'000>)->Name("dict/save/10000-records/unordered_map");
BENCHMARK(loadOurs<1'000>)->Name("dict/load/1000-records/ours");
BENCHMARK(loadStandard<1'000>)->Name("dict/load/1000-records/unordered_map");
BENCHMARK(loadOurs<10'000>)->Name("dict/load/10000-records/ours");
BENCHMARK(loadStandard<10'000>)->Name("dict/load/10000-records/unordered_map");
BENCHMARK(loadAndGetOurs<10'000>)->Name("dict/load-and-get/10000-records/ours");
BENCHMARK(loadAndGetStandard<10'000>)->Name("dict/load-and-get/10000-records/unordered_map");
BENCHMARK(setAndSaveOurs<10'000>)->Name("dict/set-and-save/10000-records/ours");
BENCHMARK(setAndSaveStandard<10'000>)->Name("dict/set-and-save/10000-records/unordered_map");

std::string const text(16 * 1024, 'x');

// What a program would write for itself: functions, as ours are.
[[gnu::noinline]] bool writeStored(IFile* file, std::vector<char> const& bytes) {
    std::uint32_t const n = static_cast<std::uint32_t>(bytes.size());
    return file->write(&n, sizeof n) == sizeof n && file->write(bytes.data(), n) == n;
}
[[gnu::noinline]] bool readStored(IFile* file, std::vector<char>& bytes) {
    std::uint32_t n = 0;
    if (file->read(&n, sizeof n) != sizeof n) return false;
    bytes.resize(n);
    return file->read(bytes.data(), n) == n;
}

template <std::size_t N>
void appendOurs(benchmark::State& state) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(text.data());
        Blob bytes;
        for (int i = 0; i < 4; ++i) bytes.add(N, text.data());
        benchmark::DoNotOptimize(bytes.buf());
        benchmark::ClobberMemory();
    }
}

template <std::size_t N>
void appendVector(benchmark::State& state) {
    for (auto _ : state) {
        benchmark::DoNotOptimize(text.data());
        std::vector<char> bytes;
        for (int i = 0; i < 4; ++i) {
            bytes.reserve(bytes.size() + N);
            bytes.insert(bytes.end(), text.data(), text.data() + N);
        }
        benchmark::DoNotOptimize(bytes.data());
        benchmark::ClobberMemory();
    }
}

template <std::size_t N>
void writeOurs(benchmark::State& state) {
    std::unique_ptr<IFile> const tape = makeTape();
    IFile* file = tape.get();
    Blob const bytes(N, text.data());
    for (auto _ : state) {
        benchmark::DoNotOptimize(file);
        file->seek(0, 0);
        bool done = bytes.write(file);
        benchmark::DoNotOptimize(done);
    }
}

template <std::size_t N>
void writeVector(benchmark::State& state) {
    std::unique_ptr<IFile> const tape = makeTape();
    IFile* file = tape.get();
    std::vector<char> const bytes(text.data(), text.data() + N);
    for (auto _ : state) {
        benchmark::DoNotOptimize(file);
        file->seek(0, 0);
        bool done = writeStored(file, bytes);
        benchmark::DoNotOptimize(done);
    }
}

template <std::size_t N>
void readOurs(benchmark::State& state) {
    std::unique_ptr<IFile> const tape = makeTape();
    IFile* file = tape.get();
    Blob(N, text.data()).write(file);
    for (auto _ : state) {
        benchmark::DoNotOptimize(file);
        file->seek(0, 0);
        Blob bytes;
        bool done = bytes.read(file);
        benchmark::DoNotOptimize(done);
        benchmark::DoNotOptimize(bytes.buf());
    }
}

template <std::size_t N>
void readVector(benchmark::State& state) {
    std::unique_ptr<IFile> const tape = makeTape();
    IFile* file = tape.get();
    Blob(N, text.data()).write(file);
    for (auto _ : state) {
        benchmark::DoNotOptimize(file);
        file->seek(0, 0);
        std::vector<char> bytes;
        bool done = readStored(file, bytes);
        benchmark::DoNotOptimize(done);
        benchmark::DoNotOptimize(bytes.data());
    }
}

BENCHMARK(appendOurs<16>)->Name("blob/append/16B/ours");
BENCHMARK(appendVector<16>)->Name("blob/append/16B/vector");
BENCHMARK(appendOurs<256>)->Name("blob/append/256B/ours");
BENCHMARK(appendVector<256>)->Name("blob/append/256B/vector");
BENCHMARK(appendOurs<16384>)->Name("blob/append/16KiB/ours");
BENCHMARK(appendVector<16384>)->Name("blob/append/16KiB/vector");
BENCHMARK(writeOurs<16>)->Name("blob/write/16B/ours");
BENCHMARK(writeVector<16>)->Name("blob/write/16B/vector");
BENCHMARK(writeOurs<16384>)->Name("blob/write/16KiB/ours");
BENCHMARK(writeVector<16384>)->Name("blob/write/16KiB/vector");
BENCHMARK(readOurs<16>)->Name("blob/read/16B/ours");
BENCHMARK(readVector<16>)->Name("blob/read/16B/vector");
BENCHMARK(readOurs<16384>)->Name("blob/read/16KiB/ours");
BENCHMARK(readVector<16384>)->Name("blob/read/16KiB/vector");

} // namespace
