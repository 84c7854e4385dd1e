#include "basis/platform/xos_basics.h"
#include "tests/support/random_steps.h"
#include "tests/support/system_error.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <set>
#include <thread>
#include <vector>

namespace {

using namespace std::chrono_literals;

/// Long enough for a thread that could go on to have done so.
constexpr auto A_WHILE = 30ms;

TEST(HostMutex, is_made_taken_given_and_destroyed) {
    xos_Sem const mutex = xos_SemMCreate();
    ASSERT_NE(mutex, 0u);
    EXPECT_EQ(xos_SemTake(mutex), 0);
    EXPECT_EQ(xos_SemGive(mutex), 0);
    EXPECT_EQ(xos_SemDestroy(mutex), 0);
}

TEST(HostMutex, is_recursive_for_its_thread) {
    xos_Sem const mutex = xos_SemMCreate();
    constexpr int DEPTH = 1000;
    for (int i = 0; i < DEPTH; ++i) { ASSERT_EQ(xos_SemTake(mutex), 0); }
    std::atomic<bool> taken{false};
    std::thread other([&] {
        xos_SemTake(mutex);
        taken = true;
        xos_SemGive(mutex);
    });
    for (int i = 0; i < DEPTH - 1; ++i) { ASSERT_EQ(xos_SemGive(mutex), 0); }
    std::this_thread::sleep_for(A_WHILE);
    EXPECT_FALSE(taken) << "still held once";
    EXPECT_EQ(xos_SemGive(mutex), 0);
    other.join();
    EXPECT_TRUE(taken);
    EXPECT_NE(xos_SemGive(mutex), 0) << "no longer ours";
    xos_SemDestroy(mutex);
}

TEST(HostMutex, is_not_given_by_another_thread_nor_when_free) {
    xos_Sem const mutex = xos_SemMCreate();
    EXPECT_NE(xos_SemGive(mutex), 0);
    xos_SemTake(mutex);
    std::thread([&] { EXPECT_NE(xos_SemGive(mutex), 0); }).join();
    std::atomic<bool> taken{false};
    std::thread other([&] {
        xos_SemTake(mutex);
        taken = true;
        xos_SemGive(mutex);
    });
    std::this_thread::sleep_for(A_WHILE);
    EXPECT_FALSE(taken);
    EXPECT_EQ(xos_SemGive(mutex), 0);
    other.join();
    xos_SemDestroy(mutex);
}

TEST(HostMutex, does_not_belong_to_a_thread_that_comes_after_its_holder) {
    xos_Sem const mutex = xos_SemMCreate();
    std::thread([&] { xos_SemTake(mutex); }).join();
    for (int i = 0; i < 20; ++i) {
        std::thread([&] { EXPECT_NE(xos_SemGive(mutex), 0); }).join();
    }
    EXPECT_EQ(xos_SemDestroy(mutex), 0);
}

TEST(HostMutex, can_be_destroyed_while_held_and_the_next_one_is_free) {
    for (int i = 0; i < 100; ++i) {
        xos_Sem const mutex = xos_SemMCreate();
        EXPECT_EQ(xos_SemTake(mutex), 0);
        EXPECT_EQ(xos_SemTake(mutex), 0);
        EXPECT_EQ(xos_SemDestroy(mutex), 0);
        xos_Sem const next = xos_SemMCreate();
        std::thread([&] {
            EXPECT_EQ(xos_SemTake(next), 0);
            EXPECT_EQ(xos_SemGive(next), 0);
        }).join();
        xos_SemDestroy(next);
    }
}

TEST(HostBinary, starts_as_it_is_told) {
    xos_Sem const available = xos_SemBCreate(1);
    EXPECT_EQ(xos_SemTake(available), 0);
    xos_SemDestroy(available);

    xos_Sem const taken = xos_SemBCreate(0);
    std::atomic<bool> passed{false};
    std::thread waiter([&] {
        EXPECT_EQ(xos_SemTake(taken), 0);
        passed = true;
    });
    std::this_thread::sleep_for(A_WHILE);
    EXPECT_FALSE(passed);
    EXPECT_EQ(xos_SemGive(taken), 0);
    waiter.join();
    xos_SemDestroy(taken);
}

TEST(HostBinary, stays_available_however_often_it_is_given) {
    xos_Sem const sem = xos_SemBCreate(1);
    EXPECT_EQ(xos_SemGive(sem), 0);
    EXPECT_EQ(xos_SemGive(sem), 0);
    EXPECT_EQ(xos_SemTake(sem), 0);
    std::atomic<bool> passed{false};
    std::thread second([&] {
        xos_SemTake(sem);
        passed = true;
    });
    std::this_thread::sleep_for(A_WHILE);
    EXPECT_FALSE(passed) << "it counts to one";
    xos_SemGive(sem);
    second.join();
    xos_SemDestroy(sem);
}

TEST(HostBinary, is_not_recursive_and_given_by_any_thread) {
    xos_Sem const sem = xos_SemBCreate(1);
    xos_SemTake(sem);
    std::thread giver([&] {
        std::this_thread::sleep_for(A_WHILE);
        EXPECT_EQ(xos_SemGive(sem), 0);
    });
    auto const start = std::chrono::steady_clock::now();
    EXPECT_EQ(xos_SemTake(sem), 0);
    EXPECT_GE(std::chrono::steady_clock::now() - start, A_WHILE - 5ms);
    giver.join();
    xos_SemDestroy(sem);
}

TEST(HostBinary, wakes_every_waiter_once_per_give) {
    constexpr int WAITERS = 8;
    xos_Sem const sem = xos_SemBCreate(0);
    std::atomic<int> passed{0};
    std::vector<std::thread> waiters;
    for (int i = 0; i < WAITERS; ++i) {
        waiters.emplace_back([&] {
            xos_SemTake(sem);
            ++passed;
        });
    }
    for (int i = 1; i <= WAITERS; ++i) {
        xos_SemGive(sem);
        while (passed < i) { std::this_thread::yield(); }
        EXPECT_EQ(passed, i);
    }
    for (std::thread& waiter : waiters) { waiter.join(); }
    xos_SemDestroy(sem);
}

/// Works for a random time around that after which a waiter goes to sleep.
void workAWhile(std::mt19937_64& random) {
    auto const end = std::chrono::steady_clock::now() + std::chrono::nanoseconds(random() % 30'000);
    while (std::chrono::steady_clock::now() < end) {}
}

TEST(HostBinary, wakes_a_waiter_that_goes_to_sleep_at_that_moment) {
    std::uint64_t const steps = randomSteps(20'000);
    xos_Sem const ping = xos_SemBCreate(0);
    xos_Sem const pong = xos_SemBCreate(0);
    std::atomic<std::uint64_t> passed{0};
    auto play = [&](xos_Sem mine, xos_Sem other, std::uint64_t seed) {
        std::mt19937_64 random{seed};
        for (std::uint64_t step = 0; step < steps; ++step) {
            xos_SemTake(mine);
            ++passed;
            workAWhile(random);
            xos_SemGive(other);
        }
    };
    std::thread first(play, ping, pong, 1);
    std::thread second(play, pong, ping, 2);
    xos_SemGive(ping);
    int idle = 0;
    for (std::uint64_t before = 0; passed < 2 * steps; before = passed) {
        std::this_thread::sleep_for(100ms);
        idle = passed == before ? idle + 1 : 0;
        if (idle == 50) {
            ADD_FAILURE() << "nobody woke up after " << passed << " turns";
            xos_SemGive(ping);
            xos_SemGive(pong);
        }
    }
    first.join();
    second.join();
    xos_SemDestroy(ping);
    xos_SemDestroy(pong);
}

TEST(HostSemaphores, fail_on_no_handle_and_on_one_that_was_destroyed) {
    for (auto* const operation : {xos_SemTake, xos_SemGive, xos_SemDestroy}) {
        clearSystemError();
        EXPECT_NE(operation(0), 0);
        EXPECT_NE(systemError(), 0);
    }
    for (xos_Sem const sem : {xos_SemMCreate(), xos_SemBCreate(1)}) {
        EXPECT_EQ(xos_SemDestroy(sem), 0);
        EXPECT_NE(xos_SemTake(sem), 0);
        EXPECT_NE(xos_SemGive(sem), 0);
        EXPECT_NE(xos_SemDestroy(sem), 0);
        xos_Sem const next = xos_SemMCreate();
        EXPECT_NE(xos_SemTake(sem), 0) << "not the one that came after it";
        xos_SemDestroy(next);
    }
}

TEST(HostSemaphores, have_handles_of_their_own) {
    constexpr int COUNT = 1000;
    std::set<xos_Sem> handles;
    for (int i = 0; i < COUNT; ++i) { handles.insert(i % 2 == 0 ? xos_SemMCreate() : xos_SemBCreate(0)); }
    EXPECT_EQ(handles.size(), static_cast<std::size_t>(COUNT));
    EXPECT_EQ(handles.count(0), 0u);
    for (xos_Sem const sem : handles) { EXPECT_EQ(xos_SemDestroy(sem), 0); }
}

TEST(HostSemaphores, made_in_one_thread_may_be_destroyed_in_another) {
    for (int round = 0; round < 5; ++round) {
        std::vector<xos_Sem> sems(200);
        std::thread([&] {
            for (xos_Sem& sem : sems) { sem = xos_SemMCreate(); }
        }).join();
        for (xos_Sem const sem : sems) {
            EXPECT_EQ(xos_SemTake(sem), 0);
            EXPECT_EQ(xos_SemGive(sem), 0);
            EXPECT_EQ(xos_SemDestroy(sem), 0);
        }
    }
}

/// What both kinds share: only one thread at a time.
class HostExclusion : public testing::TestWithParam<bool> {};

TEST_P(HostExclusion, lets_one_thread_in_at_a_time) {
    constexpr int THREADS = 4;
    std::uint64_t const steps = randomSteps(20'000);
    xos_Sem const sem = GetParam() ? xos_SemMCreate() : xos_SemBCreate(1);
    std::uint64_t guarded = 0;
    std::vector<std::thread> threads;
    for (int i = 0; i < THREADS; ++i) {
        threads.emplace_back([&, i] {
            std::mt19937_64 random{static_cast<std::uint64_t>(i)};
            for (std::uint64_t step = 0; step < steps; ++step) {
                xos_SemTake(sem);
                ++guarded;
                if (random() % 512 == 0) std::this_thread::yield();
                xos_SemGive(sem);
            }
        });
    }
    for (std::thread& thread : threads) { thread.join(); }
    EXPECT_EQ(guarded, THREADS * steps);
    xos_SemDestroy(sem);
}

INSTANTIATE_TEST_SUITE_P(BothKinds, HostExclusion, testing::Bool(),
                         [](auto const& kind) { return kind.param ? "mutex" : "binary"; });

} // namespace
