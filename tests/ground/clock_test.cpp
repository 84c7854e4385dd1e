#include "basis/ground/clock.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(PerformanceCounter, is_known_and_never_runs_back) {
    EXPECT_TRUE(PerformanceCounter::frequency().known);
    std::int64_t last = PerformanceCounter::now();
    EXPECT_GT(last, 0);
    for (int i = 0; i < 1000; ++i) {
        std::int64_t const now = PerformanceCounter::now();
        EXPECT_GE(now, last);
        last = now;
    }
}
