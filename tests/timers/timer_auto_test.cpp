#include <zor_basis/timers.h>

#include "tests/timers/assertions.h"
#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <type_traits>

using namespace ZOR_Basis;

namespace {

/// A manager that nobody asks for more than whether it is active.
class Switch : public TimerMgr {
public:
    explicit Switch(bool on) { setActive(on); }
    PileTimer* createTimer(char const*, std::uint64_t, bool) override { return nullptr; }
    PileTimer* getTimer(std::uint64_t) override { return nullptr; }
    void resetTimers(bool) override {}
};

} // namespace

template <class Auto>
class TimerAuto : public testing::Test {};

using Kinds = testing::Types<BaseTimerAuto, PileTimerAuto>;
TYPED_TEST_SUITE(TimerAuto, Kinds);

TYPED_TEST(TimerAuto, measures_its_scope) {
    OpenedPile pile("stage", true);
    {
        TypeParam timer(&pile, nullptr, true, false);
        EXPECT_EQ(static_cast<PileTimer*>(timer), &pile);
        EXPECT_STREQ(timer->cname(), "stage");
        nextTick();
        EXPECT_EQ(pile.numbers()[0], 0);
    }
    EXPECT_EQ(pile.numbers()[0], 1);
    EXPECT_GT(pile.numbers()[1], 0);
    EXPECT_EQ(pile.numbers()[6], 0);
}

TYPED_TEST(TimerAuto, begins_suspended_when_told) {
    OpenedPile pile("stage", true);
    {
        TypeParam timer(&pile, nullptr, true, true);
        nextTick();
        timer.resume();
        timer.suspend();
        timer.resume();
    }
    EXPECT_GT(pile.numbers()[6], 0);
}

TYPED_TEST(TimerAuto, is_started_by_hand) {
    OpenedPile pile("stage", true);
    TypeParam timer(&pile, nullptr, false, true);
    EXPECT_FALSE(pile.started() || pile.isSuspended());
    timer.start(false);
    timer.stop();
    timer.start(true);
    timer.stop();
    EXPECT_EQ(pile.numbers()[0], 2);
    timer.start(false); // for the end of the scope
}

TYPED_TEST(TimerAuto, without_a_pile_does_nothing) {
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
    EXPECT_EQ(pile.numbers()[0], 0);
    EXPECT_FALSE(pile.started());
    EXPECT_EQ(assertions.take(), "");
}

TYPED_TEST(TimerAuto, Kept_timers_12_asks_its_manager_once) {
    OpenedPile pile("stage", true);
    Switch manager(false);
    {
        TypeParam timer(&pile, &manager, true, false);
        manager.setActive(true);
        timer.start(false);
    }
    EXPECT_EQ(pile.numbers()[0], 0) << "off is off";
    {
        TypeParam timer(&pile, &manager, true, false);
        manager.setActive(false);
    }
    EXPECT_EQ(pile.numbers()[0], 1) << "and on is on";
}

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
    EXPECT_EQ(pile.numbers()[0], 2);
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
    EXPECT_EQ(pile.numbers()[0], 3);
    EXPECT_EQ(other.numbers()[0], 0);
}

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
    EXPECT_EQ(assertions.take(), "190 zor_basis PileTimer::start() : not started;") << "the scope stops once more";
}
