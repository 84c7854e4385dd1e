// What both scope timers have in common.

#include <zor_basis/timers.h>

#include "tests/timers/assertions.h"
#include "tests/timers/opened.h"
#include "tests/timers/switch.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

template <class Auto>
class DrivenPileOf : public testing::Test {};

} // namespace

using ScopeTimers = testing::Types<BaseTimerAuto, PileTimerAuto>;
TYPED_TEST_SUITE(DrivenPileOf, ScopeTimers);

TYPED_TEST(DrivenPileOf, measures_its_scope) {
    OpenedPile pile("stage", true);
    {
        TypeParam timer(&pile, nullptr, true, false);
        EXPECT_EQ(static_cast<PileTimer*>(timer), &pile);
        EXPECT_STREQ(timer->cname(), "stage");
        nextTick();
        EXPECT_EQ(pile.statistics().count, 0);
    }
    EXPECT_EQ(pile.statistics().count, 1);
    EXPECT_GT(pile.statistics().total, 0);
    EXPECT_EQ(pile.statistics().suspendTotal, 0);
}

TYPED_TEST(DrivenPileOf, begins_suspended_when_told) {
    OpenedPile pile("stage", true);
    {
        TypeParam timer(&pile, nullptr, true, true);
        nextTick();
        timer.resume();
        timer.suspend();
        timer.resume();
    }
    EXPECT_GT(pile.statistics().suspendTotal, 0);
}

TYPED_TEST(DrivenPileOf, is_started_by_hand) {
    OpenedPile pile("stage", true);
    TypeParam timer(&pile, nullptr, false, true);
    EXPECT_FALSE(pile.started() || pile.isSuspended());
    timer.start(false);
    timer.stop();
    timer.start(true);
    timer.stop();
    EXPECT_EQ(pile.statistics().count, 2);
    timer.start(false); // for the end of the scope
}

TYPED_TEST(DrivenPileOf, without_a_pile_does_nothing) {
    Assertions assertions;
    Switch off(false), on(true);
    OpenedPile pile("stage", true);
    {
        TypeParam nothing, null(nullptr, &on, true, false), switchedOff(&pile, &off, true, false);
        for (TypeParam* timer : {&nothing, &null, &switchedOff}) {
            EXPECT_EQ(static_cast<PileTimer*>(*timer), nullptr);
            EXPECT_EQ(timer->operator->(), nullptr);
            timer->start(true);
            timer->resume();
            timer->suspend();
            timer->stop();
        }
    }
    EXPECT_EQ(pile.statistics().count, 0);
    EXPECT_FALSE(pile.started());
    EXPECT_EQ(assertions.take(), "");
}

TYPED_TEST(DrivenPileOf, Kept_timers_12_asks_its_manager_once) {
    OpenedPile pile("stage", true);
    Switch manager(false);
    {
        TypeParam timer(&pile, &manager, true, false);
        manager.setActive(true);
        timer.start(false);
    }
    EXPECT_EQ(pile.statistics().count, 0) << "off is off";
    {
        TypeParam timer(&pile, &manager, true, false);
        manager.setActive(false);
    }
    EXPECT_EQ(pile.statistics().count, 1) << "and on is on";
}
