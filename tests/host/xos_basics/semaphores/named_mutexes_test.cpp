#include "basis/platform/xos_basics.h"
#include "tests/host/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/thread_facts.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <cstdint>
#include <memory>
#include <thread>
#include <vector>

// How often a holder is killed: 100 times where a process costs a millisecond; see CMakeLists.txt.
#ifndef HOLDERS_KILLED
#define HOLDERS_KILLED 100
#endif

namespace {

using namespace std::chrono_literals;

/// Not the same in two runs of the test.
int freshId() {
    static auto next = static_cast<std::uint32_t>(std::chrono::system_clock::now().time_since_epoch().count());
    return static_cast<int>(next++ & 0x3FFFFFFF) + 1000;
}

bool waitForFile(std::string const& path) {
    auto const end = std::chrono::steady_clock::now() + 30s;
    while (!exists(path) || textOf(path).empty()) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::sleep_for(1ms);
    }
    return true;
}

TEST(HostNamedMutex, is_made_taken_and_given) {
    std::uint32_t word = 0;
    xos_Sem const mutex = xos_SemNamedMutexCreate(freshId(), 0, 0, &word);
    ASSERT_NE(mutex, 0u);
    EXPECT_NE(word, 0u);
    EXPECT_EQ(xos_SemTake(mutex), 0);
    EXPECT_EQ(xos_SemGive(mutex), 0);
}

TEST(HostNamedMutex, is_one_for_an_id_and_another_for_another) {
    int const id = freshId();
    std::uint32_t first = 0;
    std::uint32_t second = 0;
    xos_Sem const mutex = xos_SemNamedMutexCreate(id, 0, 0, &first);
    EXPECT_EQ(xos_SemNamedMutexCreate(id, 0, 0, &first), mutex) << "from the word";
    EXPECT_EQ(xos_SemNamedMutexCreate(id, 0, 0, &second), mutex) << "from another word";
    EXPECT_EQ(second, first);
    EXPECT_EQ(xos_SemNamedMutexCreate(id, 0, 0, nullptr), mutex) << "without a word";
    std::uint32_t other = 0;
    EXPECT_NE(xos_SemNamedMutexCreate(freshId(), 0, 0, &other), mutex);
    EXPECT_NE(other, first);
}

TEST(HostNamedMutex, opens_nothing_new_when_it_is_asked_for_again) {
    int const id = freshId();
    std::uint32_t word = 0;
    xos_SemNamedMutexCreate(id, 0, 0, &word);
    std::size_t const before = openHandles();
    for (int i = 0; i < 100; ++i) {
        xos_SemNamedMutexCreate(id, 0, 0, &word);
        xos_SemNamedMutexCreate(id, 0, 0, nullptr);
    }
    EXPECT_EQ(openHandles(), before);
}

TEST(HostNamedMutex, does_not_trust_a_word_that_is_not_its_own) {
    int const id = freshId();
    xos_Sem const mutex = xos_SemNamedMutexCreate(id, 0, 0, nullptr);
    for (std::uint32_t const nonsense : {0xFFFFFFFFU, 0x80000000U, 12345U}) {
        std::uint32_t word = nonsense;
        EXPECT_EQ(xos_SemNamedMutexCreate(id, 0, 0, &word), mutex);
        EXPECT_NE(word, nonsense);
    }
    std::uint32_t ofAnother = 0;
    xos_SemNamedMutexCreate(freshId(), 0, 0, &ofAnother);
    EXPECT_EQ(xos_SemNamedMutexCreate(id, 0, 0, &ofAnother), mutex);
}

TEST(HostNamedMutex, may_have_any_number) {
    for (int const id : {0, -1, 264, 2147483647, -2147483647 - 1}) {
        xos_Sem const mutex = xos_SemNamedMutexCreate(id, 0, 0, nullptr);
        ASSERT_NE(mutex, 0u) << id;
        EXPECT_EQ(xos_SemTake(mutex), 0);
        EXPECT_EQ(xos_SemGive(mutex), 0);
    }
}

TEST(HostNamedMutex, is_recursive_and_not_given_by_another_thread) {
    xos_Sem const mutex = xos_SemNamedMutexCreate(freshId(), 0, 0, nullptr);
    EXPECT_NE(xos_SemGive(mutex), 0) << "nobody has it";
    EXPECT_EQ(xos_SemTake(mutex), 0);
    EXPECT_EQ(xos_SemTake(mutex), 0);
    std::thread([&] { EXPECT_NE(xos_SemGive(mutex), 0); }).join();
    EXPECT_EQ(xos_SemGive(mutex), 0);
    std::atomic<bool> taken{false};
    std::thread other([&] {
        xos_SemTake(mutex);
        taken = true;
        xos_SemGive(mutex);
    });
    std::this_thread::sleep_for(30ms);
    EXPECT_FALSE(taken);
    EXPECT_EQ(xos_SemGive(mutex), 0);
    other.join();
    EXPECT_NE(xos_SemGive(mutex), 0);
}

TEST(HostNamedMutex, outlives_being_destroyed) {
    int const id = freshId();
    xos_Sem const mutex = xos_SemNamedMutexCreate(id, 0, 0, nullptr);
    EXPECT_EQ(xos_SemDestroy(mutex), 0);
    EXPECT_EQ(xos_SemNamedMutexCreate(id, 0, 0, nullptr), mutex);
    EXPECT_EQ(xos_SemTake(mutex), 0);
    EXPECT_EQ(xos_SemGive(mutex), 0);
}

TEST(HostNamedMutex, is_taken_over_when_a_thread_ends_that_holds_it) {
    xos_Sem const mutex = xos_SemNamedMutexCreate(freshId(), 0, 0, nullptr);
    for (int i = 0; i < 10; ++i) {
        std::thread([&] {
            EXPECT_EQ(xos_SemTake(mutex), 0);
            EXPECT_EQ(xos_SemTake(mutex), 0);
        }).join();
        EXPECT_EQ(xos_SemTake(mutex), 0);
        EXPECT_EQ(xos_SemGive(mutex), 0);
        EXPECT_NE(xos_SemGive(mutex), 0);
    }
}

TEST(HostNamedMutex, lets_one_thread_in_at_a_time) {
    constexpr int THREADS = 4;
    constexpr int STEPS = 500;
    int const id = freshId();
    static std::uint32_t word = 0;
    int guarded = 0;
    std::vector<std::thread> threads;
    for (int i = 0; i < THREADS; ++i) {
        threads.emplace_back([&] {
            for (int step = 0; step < STEPS; ++step) {
                xos_Sem const mutex = xos_SemNamedMutexCreate(id, 0, 0, &word);
                xos_SemTake(mutex);
                ++guarded;
                xos_SemGive(mutex);
            }
        });
    }
    for (std::thread& thread : threads) { thread.join(); }
    EXPECT_EQ(guarded, THREADS * STEPS);
}

TEST(HostNamedMutex, lets_one_process_in_at_a_time) {
    constexpr int TIMES = 100;
    Scratch const scratch;
    std::string const id = std::to_string(freshId());
    put(scratch / "count", "0");
    Words const arguments{"count", id, scratch / "count", std::to_string(TIMES)};
    Child first{programBeside("host_child"), arguments};
    Child second{programBeside("host_child"), arguments};
    ASSERT_TRUE(first.isStarted());
    ASSERT_TRUE(second.isStarted());
    EXPECT_EQ(first.wait(), 0);
    EXPECT_EQ(second.wait(), 0);
    EXPECT_EQ(textOf(scratch / "count"), std::to_string(2 * TIMES));
}

TEST(HostNamedMutex, is_taken_over_when_its_holder_is_killed) {
    Scratch const scratch;
    int const id = freshId();
    put(scratch / "count", "0");
    for (int round = 1; round <= HOLDERS_KILLED; ++round) {
        std::string const mark = scratch / ("mark" + std::to_string(round));
        Child holder{programBeside("host_child"), {"hold", std::to_string(id), mark}};
        ASSERT_TRUE(waitForFile(mark));
        // A process and a thread of this one wait for it when the holder dies.
        Child contender{programBeside("host_child"), {"count", std::to_string(id), scratch / "count", "1"}};
        std::atomic<bool> taken{false};
        std::thread waiter([&] {
            xos_Sem const mutex = xos_SemNamedMutexCreate(id, 0, 0, nullptr);
            EXPECT_EQ(xos_SemTake(mutex), 0);
            taken = true;
            EXPECT_EQ(xos_SemGive(mutex), 0);
        });
        std::this_thread::sleep_for(1ms);
        EXPECT_FALSE(taken);
        holder.kill();
        waiter.join();
        EXPECT_EQ(contender.wait(), 0);
        ASSERT_EQ(textOf(scratch / "count"), std::to_string(round));
    }
}

} // namespace
