#include <zor_basis/timers.h>

#include "tests/timers/assertions.h"
#include "tests/timers/complaints.h"
#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <type_traits>

using namespace ZOR_Basis;

TEST(PileTimerAuto, drives_the_measurement_of_its_pile) {
    static_assert(!std::is_copy_constructible_v<PileTimerAuto>);
    Assertions assertions;
    OpenedPile pile("stage", true);
    {
        PileTimerAuto timer(&pile, nullptr, true, true);
        EXPECT_TRUE(pile.started() && pile.isSuspended());
        timer.resume();
        EXPECT_FALSE(pile.isSuspended());
        timer.suspend();
        EXPECT_TRUE(pile.isSuspended());
        timer.stop();
        EXPECT_FALSE(pile.started());
        EXPECT_EQ(assertions.take(), "");
    }
    EXPECT_EQ(assertions.take(), NOT_STARTED) << "the scope stops once more";
}
