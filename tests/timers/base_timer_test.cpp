#include <zor_basis/timers.h>

#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <chrono>
#include <thread>
#include <type_traits>

using namespace ZOR_Basis;

TEST(BaseTimer, breathes) {
    OpenedPile pile("stage", false);
    BaseTimer timer;
    EXPECT_TRUE(isIdle(timer));
    std::int64_t const before = BaseTimer::Clock();
    timer.start(false);
    nextTick();
    EXPECT_TRUE(timer.started());
    timer.stop(&pile);
    EXPECT_TRUE(isIdle(timer));
    Statistics const statistics = pile.statistics();
    std::int64_t const total = statistics.total;
    EXPECT_GT(total, 0);
    EXPECT_LE(total, BaseTimer::Clock() - before);
    EXPECT_EQ(statistics,
              (Statistics{.count = 1, .total = total, .max = total, .maxCount = 1, .min = total, .minCount = 1}));
}

TEST(BaseTimer, is_its_record_in_memory) {
    static_assert(std::is_standard_layout_v<BaseTimer> && sizeof(zbTimerDat) == 32);
    static_assert(std::is_same_v<decltype(zbTimerDat::start), std::int64_t>);
    BaseTimer timer;
    static_cast<zbTimerDat&>(timer) = {1, 2, 3, 4};
    auto const* const words = reinterpret_cast<std::int64_t const*>(&timer);
    for (std::int64_t i = 0; i < 4; ++i) EXPECT_EQ(words[i], i + 1);
    BaseTimer other;
    other = timer;
    EXPECT_EQ(other.suspendStart, 3);
    other = BaseTimer();
    EXPECT_TRUE(isIdle(other));
}

TEST(BaseTimer, begins_as_told) {
    EXPECT_TRUE(isIdle(BaseTimer(false, false)));
    EXPECT_TRUE(isIdle(BaseTimer(false, true))) << "the second flag means nothing alone";
    std::int64_t const before = BaseTimer::Clock();
    BaseTimer const running(true, false);
    EXPECT_GE(running.zbTimerDat::start, before);
    EXPECT_FALSE(running.isSuspended());
    BaseTimer const suspended(true, true);
    EXPECT_TRUE(suspended.started());
    EXPECT_GE(suspended.suspendStart, suspended.zbTimerDat::start);
    EXPECT_LE(suspended.suspendStart, BaseTimer::Clock());
}

TEST(BaseTimer, keeps_its_start_when_it_is_started_again) {
    BaseTimer timer(true, false);
    std::int64_t const start = timer.zbTimerDat::start;
    nextTick();
    timer.start(false);
    EXPECT_EQ(timer.zbTimerDat::start, start);
    EXPECT_FALSE(timer.isSuspended());
    timer.start(true);
    EXPECT_EQ(timer.zbTimerDat::start, start);
    EXPECT_GT(timer.suspendStart, start) << "a reading of its own";
    std::int64_t const suspension = timer.suspendStart;
    nextTick();
    timer.start(true);
    timer.suspend();
    EXPECT_EQ(timer.suspendStart, suspension);
}

TEST(BaseTimer, adds_up_its_suspensions) {
    BaseTimer timer(true, false);
    timer.resume();
    EXPECT_EQ(timer.suspended(), 0);
    timer.suspend();
    nextTick();
    EXPECT_EQ(timer.suspended(), 0) << "only what is over counts";
    timer.resume();
    std::int64_t const first = timer.suspended();
    EXPECT_GT(first, 0);
    EXPECT_FALSE(timer.isSuspended());
    timer.suspend();
    nextTick();
    timer.resume();
    EXPECT_GT(timer.suspended(), first);
}

TEST(BaseTimer, closes_an_open_suspension_at_the_reading_of_its_stop) {
    OpenedPile pile("stage", false);
    BaseTimer timer(true, false);
    timer.suspendStart = timer.zbTimerDat::start; // suspended from the very start on
    nextTick();
    timer.stop(&pile);
    Statistics const statistics = pile.statistics();
    EXPECT_GT(statistics.total, 0);
    EXPECT_EQ(statistics.total, statistics.suspendTotal) << "the whole measurement was suspended";
    EXPECT_TRUE(isIdle(timer));
}

TEST(BaseTimer, loses_its_measurement_without_a_pile) {
    BaseTimer timer(true, true);
    timer.stop(nullptr);
    EXPECT_TRUE(isIdle(timer));
}

TEST(BaseTimer, stops_only_once) {
    OpenedPile pile("stage", false);
    BaseTimer timer;
    timer.stop(&pile);
    EXPECT_EQ(pile.statistics().count, 0);
    timer.start(false);
    timer.stop(&pile);
    timer.stop(&pile);
    EXPECT_EQ(pile.statistics().count, 1);
    BaseTimer suspended;
    suspended.suspend();
    suspended.stop(&pile);
    EXPECT_TRUE(suspended.isSuspended()) << "what was not started is not stopped";
    suspended.reset();
    EXPECT_TRUE(isIdle(suspended));
}

TEST(BaseTimer, Kept_timers_01_total_is_0_after_every_measurement) {
    OpenedPile pile("stage", false);
    BaseTimer timer(true, false);
    nextTick();
    timer.stop(&pile);
    EXPECT_EQ(timer.total(), 0);
    EXPECT_EQ(finished(17).total(), 17) << "a record that was filled";
}

TEST(BaseTimer, Kept_timers_02_a_suspension_before_the_start_counts) {
    OpenedPile pile("stage", false);
    BaseTimer timer;
    timer.suspend();
    EXPECT_TRUE(timer.isSuspended());
    EXPECT_FALSE(timer.started());
    nextTick();
    timer.start(false);
    timer.stop(&pile);
    Statistics const statistics = pile.statistics();
    EXPECT_GT(statistics.suspendTotal, statistics.total) << "suspended for longer than it ran";
}

TEST(BaseTimer, counts_ticks_of_the_frequency_it_was_loaded_with) {
    EXPECT_EQ(OpenedPile::frequency(), BaseTimer::Init());
    EXPECT_GT(OpenedPile::frequency(), 0);
    auto const wall = std::chrono::steady_clock::now();
    std::int64_t const ticks = BaseTimer::Clock();
    std::this_thread::sleep_for(std::chrono::milliseconds(20));
    double const seconds = static_cast<double>(BaseTimer::Clock() - ticks) / static_cast<double>(BaseTimer::Init());
    double const expected = std::chrono::duration<double>(std::chrono::steady_clock::now() - wall).count();
    EXPECT_GE(seconds, 0.019);
    EXPECT_LE(seconds, expected + 0.005);
}
