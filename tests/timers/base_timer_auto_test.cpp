#include <zor_basis/timers.h>

#include "tests/timers/assertions.h"
#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <type_traits>

using namespace ZOR_Basis;

TEST(BaseTimerAuto, keeps_a_measurement_of_its_own) {
    static_assert(!std::is_copy_constructible_v<BaseTimerAuto>);
    OpenedPile pile("stage", true);
    Assertions assertions;
    {
        BaseTimerAuto const outer(&pile, nullptr, true, false);
        BaseTimerAuto const inner(&pile, nullptr, true, false);
        BaseTimerAuto const idle(&pile, nullptr, false, false);
        EXPECT_FALSE(pile.started());
    }
    EXPECT_EQ(pile.statistics().count, 2);
    EXPECT_EQ(assertions.take(), "");
}

TEST(BaseTimerAuto, takes_over_pile_and_measurement_by_assignment) {
    OpenedPile pile("stage", true), other("other", true);
    {
        BaseTimerAuto timer;
        BaseTimerAuto running(&pile, nullptr, true, false);
        BaseTimerAuto lost(&other, nullptr, true, false);
        timer = running;
        lost = running;
        EXPECT_EQ(static_cast<PileTimer*>(timer), &pile);
    }
    EXPECT_EQ(pile.statistics().count, 3);
    EXPECT_EQ(other.statistics().count, 0);
}
