#include "basis/sync/sem_array.h"

#include <zor_basis/sync/sem_set.h>

#include <xos_host.h>

#include "tests/support/random_steps.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <thread>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

namespace {

class SemSetTest : public testing::Test {
protected:
    ~SemSetTest() override { xos_HostFailClear(); }
};

bool soon(std::atomic<bool> const& flag) {
    for (int i = 0; i < 30 && !flag; ++i) std::this_thread::sleep_for(std::chrono::milliseconds(1));
    return flag;
}

void expectEmpty(SemArray const& set) {
    for (std::uint64_t key = 0; key < set.bucketCount(); ++key) {
        EXPECT_EQ(set.bucketOf(key)->size(), 0u);
        EXPECT_TRUE(set.bucketOf(key)->isConsistent());
    }
}

} // namespace

static_assert(std::is_convertible_v<std::size_t, SemSet>, "sets stand in arrays by their sizes");

TEST_F(SemSetTest, breathes) {
    SemSet set;
    EXPECT_TRUE(set->take(7));
    EXPECT_TRUE(set->take(7)) << "the holder may take it again";
    EXPECT_TRUE(set->take(~std::uint64_t{0}));
    EXPECT_TRUE(set->give(7));
    EXPECT_TRUE(set->give(7));
    EXPECT_TRUE(set->give(~std::uint64_t{0}));
}

TEST_F(SemSetTest, has_a_prime_number_of_buckets) {
    struct Case {
        Row row;
        std::size_t size;
        std::uint64_t buckets;
    };
    for (Case const& c :
         {Case{{}, 0, 1}, Case{{}, 1, 1}, Case{{}, 2, 2}, Case{{}, 3, 2}, Case{{}, 4, 3}, Case{{}, 7, 3},
          Case{{}, 8, 7}, Case{{}, 15, 7}, Case{{}, 16, 13}, Case{{}, 31, 13}, Case{{}, 32, 31}, Case{{}, 64, 61},
          Case{{}, 128, 127}, Case{{}, 255, 127}, Case{{}, 1000, 509}, Case{{}, std::size_t{1} << 30, 1073741789},
          Case{{}, ~std::size_t{0}, 1073741789}}) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(SemArray::bucketsFor(c.size), c.buckets);
    }
    EXPECT_EQ(SemArray(31).bucketCount(), 13u);
}

TEST_F(SemSetTest, keeps_others_out_of_a_key_and_of_no_other) {
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
    EXPECT_TRUE(soon(hasOther));
    EXPECT_FALSE(soon(hasSame));
    EXPECT_TRUE(set.give(13));
    other.join();
    EXPECT_TRUE(hasSame);
    expectEmpty(set);
}

TEST_F(SemSetTest, keeps_an_entry_as_long_as_it_has_users) {
    SemArray set(1);
    for (std::uint64_t key = 0; key < 5; ++key) EXPECT_TRUE(set.take(key));
    SemSynList const& bucket = *set.bucketOf(0);
    EXPECT_EQ(bucket.size(), 5u);
    std::uint64_t left = 5;
    for (std::uint64_t key : {2u, 0u, 4u, 3u, 1u}) { // a middle one, the last, the first, …
        EXPECT_TRUE(set.give(key));
        EXPECT_EQ(bucket.size(), --left);
        EXPECT_TRUE(bucket.isConsistent());
    }
}

TEST_F(SemSetTest, knows_no_key_that_nobody_took) {
    SemSet set;
    EXPECT_FALSE(set->give(5));
    EXPECT_TRUE(set->take(5));
    EXPECT_FALSE(set->give(18)) << "in the same bucket";
    EXPECT_TRUE(set->give(5));
    EXPECT_FALSE(set->give(5));
}

TEST_F(SemSetTest, makes_and_destroys_one_mutex_a_key) {
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

TEST_F(SemSetTest, destroys_what_is_left) {
    xos_HostCallsReset();
    {
        SemSet set(7);
        for (std::uint64_t key = 0; key < 10; ++key) set->take(key);
    }
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), xos_HostCalls("xos_SemMCreate"));
    EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 3u + 10u);
}

TEST_F(SemSetTest, fails_where_the_list_mutex_cannot_be_taken) {
    SemArray set(1);
    xos_HostFail("xos_SemTake", 0, 1);
    EXPECT_FALSE(set.take(5));
    expectEmpty(set);
    EXPECT_TRUE(set.take(5));
    xos_HostFail("xos_SemTake", 0, 1); // `give` goes on without it
    EXPECT_TRUE(set.give(5));
    expectEmpty(set);
}

TEST_F(SemSetTest, fails_where_the_mutex_of_a_key_cannot_be_taken_given_or_made) {
    SemArray set(1);
    xos_HostFail("xos_SemTake", 1, 1);
    EXPECT_FALSE(set.take(5));
    EXPECT_EQ(set.bucketOf(5)->size(), 1u) << "such a take wants its give";
    EXPECT_FALSE(set.give(5)) << "not held";
    expectEmpty(set);

    EXPECT_TRUE(set.take(5));
    xos_HostFail("xos_SemGive", 0, 1);
    EXPECT_FALSE(set.give(5));
    expectEmpty(set);

    xos_HostFail("xos_SemMCreate", 0, 1);
    EXPECT_FALSE(set.take(5));
    EXPECT_FALSE(set.give(5));
    expectEmpty(set);
    EXPECT_TRUE(set.take(5));
    EXPECT_TRUE(set.give(5));
}

TEST_F(SemSetTest, fails_in_buckets_whose_list_mutex_could_not_be_made) {
    xos_HostFail("xos_SemMCreate", 0, 1);
    SemSet set(1);
    EXPECT_FALSE(set->take(5));
    EXPECT_FALSE(set->give(5));
}

TEST_F(SemSetTest, guards_plain_counters_under_random_keys_of_eight_threads) {
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
