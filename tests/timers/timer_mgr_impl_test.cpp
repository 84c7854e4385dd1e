#include "basis/timers/timer_mgr_impl.h"
#include "zor_basis/timers.h"

#include <xos_host.h>

#include "tests/support/table.h"
#include "tests/timers/assertions.h"
#include "tests/timers/complaints.h"
#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <vector>

using namespace ZOR_Basis;

namespace {

/// Removes the faults that a test has set in the platform layer.
class TimerMgrImplOnHost : public testing::Test {
protected:
    ~TimerMgrImplOnHost() override { xos_HostFailClear(); }
};

} // namespace

TEST_F(TimerMgrImplOnHost, gives_ids) {
    struct Case {
        Row row;
        std::uint64_t maxId;
        std::vector<std::uint64_t> asked, given;
    };
    for (Case const& c : {
             Case{{}, 0, {0, 0, 0}, {0, 1, 2}}, Case{{}, 5, {0, 3, 0}, {6, 3, 7}}, Case{{}, 0, {3, 0}, {3, 4}},
             Case{{}, 1, {0}, {2}}, Case{{}, 0, {40, 0, 9, 0}, {40, 41, 9, 42}}, Case{{}, 7, {7, 0, 8}, {7, 8, 8}},
             Case{{}, 0, std::vector<std::uint64_t>(9, 0), {0, 1, 2, 3, 4, 5, 6, 7, 8}}, // grows
         }) {
        SCOPED_TRACE(c.row);
        Assertions assertions;
        TimerMgrImpl manager("ids", c.maxId);
        EXPECT_EQ(manager.getTimer(0), nullptr);
        std::vector<PileTimer*> displaced;
        for (std::size_t i = 0; i < c.asked.size(); ++i) {
            PileTimer* const before = manager.getTimer(c.given[i]);
            PileTimer* const timer = manager.createTimer("timer", c.asked[i], false);
            EXPECT_EQ(timer->id(), c.given[i]);
            EXPECT_EQ(manager.getTimer(c.given[i]), timer);
            EXPECT_EQ(assertions.take(), before != nullptr ? ALREADY_REGISTERED : "");
            delete before;
        }
    }
}

TEST_F(TimerMgrImplOnHost, makes_timers_that_check_of_the_kind_that_is_asked_for) {
    Assertions assertions;
    TimerMgrImpl manager("kinds", 0);
    for (bool forThreads : {false, true}) {
        PileTimer* const timer = manager.createTimer("timer", 0, forThreads);
        EXPECT_EQ(dynamic_cast<PileTimerMT*>(timer) != nullptr, forThreads);
        EXPECT_STREQ(timer->cname(), "timer");
        timer->stop();
        EXPECT_NE(assertions.take(), "");
    }
    EXPECT_EQ(manager.createTimer(nullptr, 0, false)->cname(), Str::StrEmpty);
}

TEST_F(TimerMgrImplOnHost, Kept_timers_09_a_displaced_timer_stays_alive) {
    Assertions assertions;
    PileTimer* first = nullptr;
    {
        TimerMgrImpl manager("displaced", 5);
        first = manager.createTimer("first", 3, true);
        PileTimer* const second = manager.createTimer("second", 3, false);
        EXPECT_EQ(assertions.take(), ALREADY_REGISTERED);
        EXPECT_EQ(manager.getTimer(3), second);
        EXPECT_EQ(second->id(), 3u);
        manager.setActive(true);
        pileUp(*first, 5);
        manager.reset(false);
        EXPECT_EQ(countOf(first), "1") << "the manager no longer owns it";
    }
    EXPECT_STREQ(first->cname(), "first");
    delete first;
}

TEST_F(TimerMgrImplOnHost, deletes_its_timers_and_its_semaphore) {
    xos_HostCallsReset();
    {
        TimerMgrImpl manager("ends", 5);
        manager.createTimer("a", 3, true);
        manager.createTimer("b", 0, true);
        manager.createTimer("c", 0, false);
        EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 3u);
    }
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 3u);
}

TEST_F(TimerMgrImplOnHost, resets_only_while_active) {
    TimerMgrImpl manager("resets", 0);
    PileTimer* const timer = manager.createTimer("timer", 0, false);
    pileUp(*timer, 5);
    manager.reset(false);
    EXPECT_EQ(countOf(timer), "1");
    manager.resetTimers(false);
    EXPECT_EQ(countOf(timer), "0") << "a direct call resets even an inactive manager";
}

TEST_F(TimerMgrImplOnHost, works_without_semaphores_and_gives_back_only_what_it_took) {
    xos_HostFail("xos_SemMCreate", 0, 2);
    TimerMgrImpl without("without", 0);
    PileTimer* const timer = without.createTimer("timer", 0, true);
    pileUp(*timer, 5);
    EXPECT_EQ(countOf(timer), "1");
    without.resetTimers(false);
    EXPECT_EQ(countOf(timer), "0");

    TimerMgrImpl manager("takes", 0);
    xos_HostFail("xos_SemTake", 0, 2);
    xos_HostCallsReset();
    PileTimer* const other = manager.createTimer("timer", 0, false);
    pileUp(*other, 5);
    manager.resetTimers(false);
    EXPECT_EQ(countOf(other), "0");
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 0u);
    manager.resetTimers(false);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 1u);
}
