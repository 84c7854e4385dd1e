#include <zor_basis/sync/sem_set.h>

#include "tests/support/random_steps.h"
#include "tests/sync/sem_buckets.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <thread>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

namespace {

struct SemSetOfKeys : SemaphoresMayFail {};

bool isSetSoon(std::atomic<bool> const& flag) {
    for (int i = 0; i < 30 && !flag; ++i) std::this_thread::sleep_for(std::chrono::milliseconds(1));
    return flag;
}

} // namespace

static_assert(std::is_convertible_v<std::size_t, SemSet>, "sets stand in arrays by their sizes");

TEST_F(SemSetOfKeys, breathes) {
    SemSet set;
    EXPECT_TRUE(set->take(7));
    EXPECT_TRUE(set->take(7)) << "the holder may take it again";
    EXPECT_TRUE(set->take(~std::uint64_t{0}));
    EXPECT_TRUE(set->give(7));
    EXPECT_TRUE(set->give(7));
    EXPECT_TRUE(set->give(~std::uint64_t{0}));
}

TEST_F(SemSetOfKeys, keeps_others_out_of_a_key_and_of_no_other) {
    SemArray set(31);
    ASSERT_TRUE(set.take(13));
    ASSERT_EQ(set.bucketOf(13), set.bucketOf(26)) << "both in one bucket";
    std::atomic<bool> hasOther{false};
    std::atomic<bool> hasSame{false};
    std::thread other([&] {
        EXPECT_TRUE(set.take(26));
        hasOther = true;
        EXPECT_TRUE(set.take(13));
        hasSame = true;
        EXPECT_TRUE(set.give(13));
        EXPECT_TRUE(set.give(26));
    });
    EXPECT_TRUE(isSetSoon(hasOther));
    EXPECT_FALSE(isSetSoon(hasSame));
    EXPECT_TRUE(set.give(13));
    other.join();
    EXPECT_TRUE(hasSame);
    expectEmpty(set);
}

TEST_F(SemSetOfKeys, knows_no_key_that_nobody_took) {
    SemSet set;
    EXPECT_FALSE(set->give(5));
    EXPECT_TRUE(set->take(5));
    EXPECT_FALSE(set->give(18)) << "in the same bucket";
    EXPECT_TRUE(set->give(5));
    EXPECT_FALSE(set->give(5));
}

TEST_F(SemSetOfKeys, makes_and_destroys_one_mutex_a_key) {
    SemSet set(100);
    xos_HostCallsReset();
    set->take(1);
    EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 1u);
    set->take(1);
    EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 1u);
    set->give(1);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 0u);
    set->give(1);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
}

TEST_F(SemSetOfKeys, guards_plain_counters_under_random_keys_of_eight_threads) {
    constexpr std::uint64_t KEYS = 40;
    constexpr unsigned THREADS = 8;
    SemArray set(16);
    std::vector<std::uint64_t> counters(KEYS); // not atomic: the keys guard them
    std::uint64_t const steps = randomSteps(4000);
    std::vector<std::thread> threads;
    for (unsigned t = 0; t < THREADS; ++t) {
        threads.emplace_back([&, t] {
            std::mt19937_64 random(t);
            for (std::uint64_t i = 0; i < steps; ++i) {
                std::uint64_t const key = random() % KEYS;
                ASSERT_TRUE(set.take(key));
                ++counters[key];
                if (random() % 16 == 0) std::this_thread::yield();
                ASSERT_TRUE(set.give(key));
            }
        });
    }
    for (std::thread& thread : threads) thread.join();
    std::uint64_t total = 0;
    for (std::uint64_t counter : counters) total += counter;
    EXPECT_EQ(total, THREADS * steps);
    expectEmpty(set);
}
