#include "basis/sync/sem_syn_list.h"

#include "tests/sync/sem_buckets.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct SemSynListEntries : SemaphoresMayFail {};

} // namespace

TEST_F(SemSynListEntries, keeps_an_entry_as_long_as_it_has_users) {
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

TEST_F(SemSynListEntries, fails_where_the_list_mutex_cannot_be_taken) {
    SemArray set(1);
    xos_HostFail("xos_SemTake", 0, 1);
    EXPECT_FALSE(set.take(5));
    expectEmpty(set);
    EXPECT_TRUE(set.take(5));
    xos_HostFail("xos_SemTake", 0, 1); // `give` goes on without it
    EXPECT_TRUE(set.give(5));
    expectEmpty(set);
}

TEST_F(SemSynListEntries, fails_where_the_mutex_of_a_key_cannot_be_taken_given_or_made) {
    SemArray set(1);
    xos_HostFail("xos_SemTake", 1, 1);
    EXPECT_FALSE(set.take(5));
    EXPECT_EQ(set.bucketOf(5)->size(), 1u) << "such a take must be matched by a give";
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
