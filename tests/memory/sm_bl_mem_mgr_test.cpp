#include "basis/memory/sm_bl_mem_mgr.h"

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cstring>
#include <iterator>
#include <map>
#include <vector>

using namespace ZOR_Basis;

namespace {

char* bytes(void* p) { return static_cast<char*>(p); }

/// Allocates up to the end of the current chunk and expects each element directly below the previous one.
void useUpChunk(SmBlMemMgr& manager, std::uint64_t alreadyUsed, std::uint64_t stride) {
    std::uint64_t const room = manager.chunkSize() / stride - alreadyUsed;
    std::uint64_t const chunk = manager.chunkCount();
    char* last = nullptr;
    for (std::uint64_t i = 0; i < room; ++i) {
        char* const next = bytes(manager.alloc());
        EXPECT_TRUE(last == nullptr || last - next == static_cast<std::ptrdiff_t>(stride));
        last = next;
    }
    EXPECT_EQ(manager.chunkCount(), chunk);
}

struct Sizes {
    Row row;
    std::uint64_t elemSize, count, maxCount, align;
    std::uint64_t stride;
    std::vector<std::uint64_t> chunks;
};

Sizes const SIZES[] = {
    {{}, 24, 100, 0, 8, 24, {4096, 8192, 16384, 16384}},
    {{}, 10, 0, 0, 4, 12, {256, 512, 1024, 1024}},
    {{}, 3, 16, 0, 1, 4, {128, 256, 512, 512}},
    {{}, 8, 16, 0, 100, 8, {256, 512, 1024, 1024}},
    {{}, 9, 16, 0, 7, 12, {256, 512, 1024}},
    {{}, 16, 16, 64, 8, 16, {512, 1024, 2048, 2048}},                      // four times as many: the hint counts
    {{}, 16, 16, 1000, 8, 16, {512, 1024, 2048, 4096}},                    //
    {{}, 16, 16, 63, 8, 16, {512, 1024, 2048, 2048}},                      // one less: it does not
    {{}, 1024, 100'000, 0, 8, 1024, {1 << 20, 2 << 20, 4 << 20, 4 << 20}}, // the first has 1 MiB at most
    {{}, 1024, 16, 1'000'000, 8, 1024, {32768, 65536, 131072}},
    {{}, 124, 0, 0, 4, 124, {2048, 4096, 8192, 8192}},                           // 17 elements would take more
    {{}, 1024, 1'000, 1'000'000, 8, 1024, {1 << 20, 2 << 20, 4 << 20, 4 << 20}}, // 4 MiB at most
};

} // namespace

TEST(SmBlMemMgr, sets_up_element_and_chunk_sizes) {
    for (Sizes const& c : SIZES) {
        SCOPED_TRACE(c.row);
        SmBlMemMgr manager(c.elemSize, c.count, c.maxCount, c.align);
        std::uint64_t alreadyUsed = 0;
        for (std::uint64_t chunk : c.chunks) {
            EXPECT_EQ(manager.chunkSize(), chunk);
            useUpChunk(manager, alreadyUsed, c.stride);
            EXPECT_NE(manager.alloc(), nullptr); // the first of the next chunk
            alreadyUsed = 1;
        }
        EXPECT_EQ(manager.chunkCount(), c.chunks.size() + 1);
        EXPECT_TRUE(manager.isConsistent());
    }
}

TEST(SmBlMemMgr, carves_downwards_and_takes_the_last_element_back) {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(24, 100, 0, 8));
    char* const a = bytes(manager->alloc());
    char* const b = bytes(manager->alloc());
    EXPECT_EQ(a - b, 24);
    manager->free(b);
    EXPECT_EQ(manager->alloc(), b);
    manager->free(b);
    manager->free(a); // b went back to the chunk, so a is its last element now
    EXPECT_EQ(manager->alloc(), a);
    EXPECT_EQ(manager->alloc(), b);
}

TEST(SmBlMemMgr, takes_the_last_element_back_into_the_chunk_beside_those_that_were_freed) {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(24, 100, 0, 8));
    char* const a = bytes(manager->alloc());
    char* const b = bytes(manager->alloc());
    manager->free(a); // to those that were freed
    manager->free(b); // back to the chunk
    EXPECT_EQ(manager->alloc(), a);
    EXPECT_EQ(manager->alloc(), b);
}

TEST(SmBlMemMgr, gives_the_last_freed_element_first) {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(24, 100, 0, 8));
    void* const a = manager->alloc();
    void* const b = manager->alloc();
    manager->alloc();
    manager->free(a);
    manager->free(b, 5);
    EXPECT_EQ(manager->alloc(), b);
    EXPECT_EQ(manager->alloc(24), a);
    manager->free(nullptr);
    EXPECT_NE(manager->alloc(), nullptr);
}

TEST(SmBlMemMgr, refuses_what_is_larger_than_an_element) {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(10, 0, 0, 4));
    EXPECT_NE(manager->alloc(0), nullptr);
    EXPECT_NE(manager->alloc(1), nullptr);
    EXPECT_NE(manager->alloc(12), nullptr) << "the size is rounded up";
    EXPECT_EQ(manager->alloc(13), nullptr);
}

TEST(SmBlMemMgr, refuses_elements_that_no_memory_holds) {
    constexpr std::uint64_t MOST = ~std::uint64_t{0};
    for (std::uint64_t size : {MOST, MOST - 1, MOST - 7, MOST / 2}) {
        for (std::uint64_t align : {2, 4, 8}) {
            MemMgrPtr const manager(MemMgr::makeSmlBlk(size, 1, 0, align));
            EXPECT_EQ(manager->alloc(), nullptr) << size << ", " << align;
            EXPECT_EQ(manager->alloc(1), nullptr) << size << ", " << align;
        }
    }
}

TEST(SmBlMemMgr, Kept_memory_01_small_elements_are_not_widened) {
    MemMgrPtr const manager(MemMgr::makeSmlBlk(3, 16, 0, 1));
    char* const first = bytes(manager->alloc());
    char* const second = bytes(manager->alloc());
    manager->alloc();
    EXPECT_EQ(first - second, 4);
    std::memset(first, 'x', 4);
    manager->free(second); // eight bytes of a null pointer into four
    EXPECT_EQ(std::memcmp(first, "\0\0\0\0", 4), 0);
}

TEST(SmBlMemMgr, serves_elements_larger_than_its_first_chunk) {
    constexpr std::uint64_t MIB = 1 << 20;
    SmBlMemMgr large(3 * MIB, 1, 0, 8);
    for (int i = 0; i < 3; ++i) {
        void* const p = large.alloc();
        ASSERT_NE(p, nullptr);
        std::memset(p, i, 3 * MIB);
    }
    EXPECT_TRUE(large.isConsistent());
    SmBlMemMgr tooLarge(5 * MIB, 1, 0, 8);
    EXPECT_EQ(tooLarge.alloc(), nullptr);
    std::uint64_t const chunks = tooLarge.chunkCount();
    EXPECT_LE(chunks, 3u) << "of 1, 2 and 4 MiB";
    for (int i = 0; i < 10; ++i) EXPECT_EQ(tooLarge.alloc(), nullptr);
    EXPECT_EQ(tooLarge.chunkCount(), chunks) << "no chunk after chunk that cannot hold an element";
    MemMgrPtr const none(MemMgr::makeSmlBlk(0, 0, 0, 0));
    none->free(none->alloc());
}

TEST(SmBlMemMgrModel, never_overlaps_and_always_aligns) {
    std::mt19937_64 random = randomSource();
    for (std::uint64_t elemSize : {8u, 12u, 24u, 100u}) {
        for (std::uint64_t align : {2u, 4u, 8u}) {
            SmBlMemMgr manager(elemSize, 20, 0, align);
            std::map<char*, unsigned char> living; // address, the byte it is filled with
            unsigned char mark = 0;
            for (std::uint64_t step = randomSteps(3000); step > 0; --step) {
                if (random() % 100 < 55 || living.empty()) {
                    char* const p = bytes(manager.alloc());
                    ASSERT_EQ(reinterpret_cast<std::uintptr_t>(p) % align, 0u);
                    auto const above = living.lower_bound(p);
                    ASSERT_TRUE(above == living.end() || above->first >= p + elemSize);
                    ASSERT_TRUE(above == living.begin() || std::prev(above)->first + elemSize <= p);
                    std::memset(p, ++mark, elemSize);
                    living[p] = mark;
                } else {
                    auto place = living.begin();
                    std::advance(place, static_cast<std::ptrdiff_t>(random() % living.size()));
                    for (std::uint64_t i = 0; i < elemSize; ++i)
                        ASSERT_EQ(static_cast<unsigned char>(place->first[i]), place->second);
                    manager.free(place->first);
                    living.erase(place);
                }
                ASSERT_TRUE(step % 64 != 0 || manager.isConsistent());
            }
        }
    }
}
