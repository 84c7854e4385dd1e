#include "basis/timers/base_timer_impl.h"

#include "tests/timers/assertions.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(CheckedFrequency, Kept_timers_03_that_is_missing_is_reported_under_an_old_name) {
    Assertions assertions;
    EXPECT_EQ(checkedFrequency({true, 10'000'000}), 10'000'000);
    EXPECT_EQ(assertions.take(), "");
    EXPECT_EQ(checkedFrequency({false, 5}), 5) << "what the system left is used";
    EXPECT_EQ(assertions.take(), "100 zor_basis PileTimer::Clock() - clock API not supported!;");
}
