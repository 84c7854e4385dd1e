/// \file
/// Sets of locks whose semaphores may fail, and a look into their buckets.

#ifndef TESTS_SYNC_SEM_BUCKETS_H
#define TESTS_SYNC_SEM_BUCKETS_H

#include "basis/sync/sem_array.h"

#include <xos_host.h>

#include <gtest/gtest.h>

struct SemaphoresMayFail : testing::Test {
    ~SemaphoresMayFail() override { xos_HostFailClear(); }
};

inline void expectEmpty(ZOR_Basis::SemArray const& set) {
    for (std::uint64_t key = 0; key < set.bucketCount(); ++key) {
        EXPECT_EQ(set.bucketOf(key)->size(), 0u);
        EXPECT_TRUE(set.bucketOf(key)->isConsistent());
    }
}

#endif
