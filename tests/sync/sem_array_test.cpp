#include "basis/sync/sem_array.h"

#include "tests/support/table.h"
#include "tests/sync/sem_buckets.h"

#include <zor_basis/sync/sem_set.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct SemArrayBuckets : SemaphoresMayFail {};

} // namespace

TEST_F(SemArrayBuckets, has_a_prime_number_of_buckets) {
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

TEST_F(SemArrayBuckets, destroys_what_is_left) {
    xos_HostCallsReset();
    {
        SemSet set(7);
        for (std::uint64_t key = 0; key < 10; ++key) set->take(key);
    }
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), xos_HostCalls("xos_SemMCreate"));
    EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 3u + 10u);
}

TEST_F(SemArrayBuckets, fails_in_buckets_whose_list_mutex_could_not_be_made) {
    xos_HostFail("xos_SemMCreate", 0, 1);
    SemSet set(1);
    EXPECT_FALSE(set->take(5));
    EXPECT_FALSE(set->give(5));
}
