// The small-block manager through its interface, beside mimalloc, a bare free list and the runtime's heap.

#include <zor_basis/memory.h>

#include <benchmark/benchmark.h>

#ifdef BENCH_HAS_MIMALLOC
#include <mimalloc.h>
#endif

#include <algorithm>
#include <cstdlib>
#include <memory>
#include <random>
#include <string>
#include <vector>

using namespace ZOR_Basis;

namespace {

struct Ours {
    explicit Ours(std::uint64_t size) : manager(MemMgr::makeSmlBlk(size, 1000, 100'000, 8)) {}
    void* alloc() { return manager->alloc(); }
    void free(void* p) { manager->free(p); }
    MemMgrPtr manager;
};

#ifdef BENCH_HAS_MIMALLOC
struct Mimalloc {
    explicit Mimalloc(std::uint64_t s) : size(s) {}
    void* alloc() { return mi_malloc(size); }
    void free(void* p) { mi_free(p); }
    std::uint64_t size;
};
#endif

struct Heap {
    explicit Heap(std::uint64_t s) : size(s) {}
    void* alloc() { return std::malloc(size); }
    void free(void* p) { std::free(p); }
    std::uint64_t size;
};

/// No chunks, no interface: links through elements of one block that is there from the start.
struct FreeList {
    explicit FreeList(std::uint64_t size) : block(new char[size * 100'000]) {
        for (std::uint64_t i = 0; i < 100'000; ++i) free(block.get() + i * size);
    }
    void* alloc() {
        void* const p = head;
        head = *static_cast<void**>(head);
        return p;
    }
    void free(void* p) {
        *static_cast<void**>(p) = head;
        head = p;
    }
    std::unique_ptr<char[]> block;
    void* head = nullptr;
};

template <class Side>
void pair(benchmark::State& state) {
    Side side(static_cast<std::uint64_t>(state.range(0)));
    void* const below = side.alloc(); // so that the pair does not touch the end of what is used
    for (auto _ : state) {
        void* const p = side.alloc();
        benchmark::DoNotOptimize(p);
        side.free(p);
    }
    side.free(below);
}

constexpr std::size_t MANY = 100'000;

template <class Side>
void allocateMany(benchmark::State& state) {
    std::vector<void*> elements(MANY);
    for (auto _ : state) {
        state.PauseTiming();
        auto side = std::make_unique<Side>(static_cast<std::uint64_t>(state.range(0)));
        state.ResumeTiming();
        for (void*& element : elements) *static_cast<char*>(element = side->alloc()) = 1;
        benchmark::ClobberMemory();
        state.PauseTiming();
        for (void* element : elements) side->free(element);
        side.reset();
        state.ResumeTiming();
    }
}

template <class Side>
void freeRandomly(benchmark::State& state) {
    std::mt19937_64 random(3);
    std::vector<void*> elements(MANY);
    for (auto _ : state) {
        state.PauseTiming();
        auto side = std::make_unique<Side>(static_cast<std::uint64_t>(state.range(0)));
        for (void*& element : elements) *static_cast<char*>(element = side->alloc()) = 1;
        std::shuffle(elements.begin(), elements.end(), random);
        state.ResumeTiming();
        for (void* element : elements) side->free(element);
        benchmark::ClobberMemory();
        state.PauseTiming();
        side.reset();
        state.ResumeTiming();
    }
}

template <class Side>
void add(char const* who) {
    for (std::int64_t size : {24, 64}) {
        auto name = [&](char const* row) { return std::string(row) + "-" + std::to_string(size) + "/" + who; };
        benchmark::RegisterBenchmark(name("pair").c_str(), pair<Side>)->Arg(size);
        benchmark::RegisterBenchmark(name("allocate").c_str(), allocateMany<Side>)->Arg(size);
        benchmark::RegisterBenchmark(name("free-random").c_str(), freeRandomly<Side>)->Arg(size);
    }
}

bool registerAll() {
    add<Ours>("ours");
#ifdef BENCH_HAS_MIMALLOC
    add<Mimalloc>("mimalloc");
#endif
    add<FreeList>("free-list");
    add<Heap>("malloc");
    return true;
}

bool const registered = registerAll();

} // namespace
