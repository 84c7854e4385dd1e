// Lists, pointer arrays and the hash beside what the standard library and a plain loop do.

#include <zor_basis/containers.h>

#include <benchmark/benchmark.h>

#include <algorithm>
#include <cstring>
#include <forward_list>
#include <list>
#include <random>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// Bytes on the heap as a dictionary's keys are: compared by `memcmp`, the shorter first.
struct SmallBlob {
    std::vector<char> bytes;
    bool operator<(SmallBlob const& other) const {
        std::size_t const shorter = std::min(bytes.size(), other.bytes.size());
        int const order = std::memcmp(bytes.data(), other.bytes.data(), shorter);
        return order != 0 ? order < 0 : bytes.size() < other.bytes.size();
    }
};

template <class T>
T make(std::mt19937_64& random);

template <>
int make(std::mt19937_64& random) {
    return static_cast<int>(random());
}

template <>
SmallBlob make(std::mt19937_64& random) {
    SmallBlob blob;
    for (std::uint64_t n = 4 + random() % 12; n > 0; --n) blob.bytes.push_back(static_cast<char>(random() % 4));
    return blob;
}

// Values differ from round to round, as a branch predictor learns a list that it sees again.
constexpr int VARIANTS = 8;

template <class List, class Fill, class Sort>
void sortLists(benchmark::State& state, Fill fill, Sort sort) {
    std::mt19937_64 random(1);
    std::int64_t const count = state.range(0);
    for (auto _ : state) {
        state.PauseTiming();
        List list;
        for (std::int64_t i = 0; i < count; ++i) fill(list, random);
        state.ResumeTiming();
        sort(list);
        state.PauseTiming();
        list.clear();
        state.ResumeTiming();
    }
}

template <class T>
void sortOurs(benchmark::State& state) {
    sortLists<SngList<T>>(
        state, [](auto& list, auto& random) { list.insertFront(make<T>(random)); },
        [](auto& list) { list.sort(true); });
}
template <class T>
void sortForward(benchmark::State& state) {
    sortLists<std::forward_list<T>>(
        state, [](auto& list, auto& random) { list.push_front(make<T>(random)); }, [](auto& list) { list.sort(); });
}
template <class T>
void sortStdList(benchmark::State& state) {
    sortLists<std::list<T>>(
        state, [](auto& list, auto& random) { list.push_front(make<T>(random)); }, [](auto& list) { list.sort(); });
}

int value;

void pushOurs(benchmark::State& state) {
    for (auto _ : state) {
        PtrArray<int> array;
        for (std::int64_t i = 0; i < state.range(0); ++i) array.insertBack(&value);
        benchmark::DoNotOptimize(array[0]);
    }
}
void pushVector(benchmark::State& state) {
    for (auto _ : state) {
        std::vector<int*> array;
        array.reserve(8);
        for (std::int64_t i = 0; i < state.range(0); ++i) array.push_back(&value);
        benchmark::DoNotOptimize(array[0]);
    }
}
void iterateOurs(benchmark::State& state) {
    PtrArray<int> array;
    for (std::int64_t i = 0; i < state.range(0); ++i) array.insertBack(&value);
    for (auto _ : state) {
        std::uintptr_t sum = 0;
        for (std::uint64_t i = 0; i < array.size(); ++i) sum += reinterpret_cast<std::uintptr_t>(array[i]);
        benchmark::DoNotOptimize(sum);
        benchmark::ClobberMemory();
    }
}
void iterateVector(benchmark::State& state) {
    std::vector<int*> array(static_cast<std::size_t>(state.range(0)), &value);
    for (auto _ : state) {
        std::uintptr_t sum = 0;
        for (std::uint64_t i = 0; i < array.size(); ++i) sum += reinterpret_cast<std::uintptr_t>(array[i]);
        benchmark::DoNotOptimize(sum);
        benchmark::ClobberMemory();
    }
}

__attribute__((noinline)) std::uint64_t plainHash(char const* text) {
    std::uint64_t hash = 5381;
    for (; *text != '\0'; ++text) {
        hash = hash * 33 + static_cast<std::uint64_t>(std::int64_t{static_cast<signed char>(*text)});
    }
    return hash;
}

template <class Hash>
void hashTexts(benchmark::State& state, Hash hash) {
    std::mt19937_64 random(2);
    std::vector<std::string> texts(VARIANTS, std::string(static_cast<std::size_t>(state.range(0)), '\0'));
    for (std::string& text : texts) {
        for (char& c : text) c = static_cast<char>(1 + random() % 255);
        if (hash(text.c_str()) != plainHash(text.c_str())) state.SkipWithError("wrong hash");
    }
    std::size_t next = 0;
    for (auto _ : state) benchmark::DoNotOptimize(hash(texts[next++ % VARIANTS].c_str()));
}
void hashOurs(benchmark::State& state) {
    hashTexts(state, [](char const* text) { return hashDjb2(text, 0); });
}
void hashPlain(benchmark::State& state) { hashTexts(state, plainHash); }

void add(std::string const& row, char const* who, void (*function)(benchmark::State&), std::int64_t size) {
    auto* const made = benchmark::RegisterBenchmark((row + "-" + std::to_string(size) + "/" + who).c_str(), function);
    made->Arg(size);
}

bool registerAll() {
    for (std::int64_t size : {100, 1000, 10'000, 100'000}) {
        add("sort-int", "ours", sortOurs<int>, size);
        add("sort-int", "forward_list", sortForward<int>, size);
        add("sort-int", "list", sortStdList<int>, size);
        add("sort-blob", "ours", sortOurs<SmallBlob>, size);
        add("sort-blob", "forward_list", sortForward<SmallBlob>, size);
        add("sort-blob", "list", sortStdList<SmallBlob>, size);
    }
    for (std::int64_t size : {8, 100, 10'000}) {
        add("push", "ours", pushOurs, size);
        add("push", "vector", pushVector, size);
        add("iterate", "ours", iterateOurs, size);
        add("iterate", "vector", iterateVector, size);
    }
    for (std::int64_t size : {8, 32, 256}) {
        add("hash", "ours", hashOurs, size);
        add("hash", "loop", hashPlain, size);
    }
    return true;
}

bool const registered = registerAll();

} // namespace
