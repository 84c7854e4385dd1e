#include "host/xos_basics/wait/lock_word.h"

#include "host/xos_basics/wait/quick_mutex.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <mutex>
#include <thread>
#include <vector>

namespace {

TEST(HostLockWord, is_taken_at_once_only_while_it_is_free) {
    host::LockWord lock;
    EXPECT_TRUE(host::isTakenAtOnce(lock));
    EXPECT_FALSE(host::isTakenAtOnce(lock));
    host::giveWord(lock);
    EXPECT_TRUE(host::isTakenAtOnce(lock));
}

TEST(HostLockWord, wakes_a_thread_that_fell_asleep) {
    host::LockWord lock;
    host::takeWord(lock);
    std::atomic<bool> isTaken{false};
    std::thread sleeper([&] {
        host::takeWord(lock);
        isTaken = true;
        host::giveWord(lock);
    });
    // Far longer than a thread looks for the lock awake.
    std::this_thread::sleep_for(std::chrono::milliseconds(30));
    EXPECT_EQ(lock.awaited, 1u);
    EXPECT_FALSE(isTaken);
    host::giveWord(lock);
    sleeper.join();
    EXPECT_TRUE(isTaken);
}

TEST(HostLockWord, may_be_given_by_another_thread) {
    host::LockWord lock;
    host::takeWord(lock);
    std::thread([&] { host::giveWord(lock); }).join();
    EXPECT_TRUE(host::isTakenAtOnce(lock));
}

TEST(HostLockWord, lets_one_thread_in_at_a_time) {
    constexpr int THREADS = 4;
    constexpr int ROUNDS = 5'000;
    host::QuickMutex mutex;
    int guarded = 0;
    std::vector<std::thread> threads;
    for (int i = 0; i < THREADS; ++i) {
        threads.emplace_back([&] {
            for (int j = 0; j < ROUNDS; ++j) {
                std::lock_guard const lock{mutex};
                ++guarded;
            }
        });
    }
    for (std::thread& thread : threads) { thread.join(); }
    EXPECT_EQ(guarded, THREADS * ROUNDS);
}

} // namespace
