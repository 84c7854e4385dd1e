#include <zor_basis/timers.h>

#include <xos_host.h>

#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <thread>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

namespace {

/// Removes the faults that a test has set in the platform layer.
class PileTimerMTOnHost : public testing::Test {
protected:
    ~PileTimerMTOnHost() override { xos_HostFailClear(); }
};

} // namespace

TEST_F(PileTimerMTOnHost, holds_its_mutex_around_each_piling) {
    static_assert(!std::is_copy_constructible_v<PileTimerMT>);
    xos_HostCallsReset();
    {
        Opened<PileTimerMT> pile("stage", true);
        EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 1u);
        EXPECT_EQ(xos_HostCalls("xos_SemTake"), 0u);
        pileUp(pile, 5);
        pile.start(false);
        pile.stop();
        EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u);
        EXPECT_EQ(xos_HostCalls("xos_SemGive"), 2u);
        BaseTimer idle;
        pile.addTotal(idle);
        BufStr<255> line;
        pile.print(line, 1);
        pile.reset();
        EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u) << "nothing else is locked";
    }
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
}

TEST_F(PileTimerMTOnHost, piles_without_a_mutex_that_cannot_be_made_or_taken) {
    xos_HostFail("xos_SemMCreate", 0, 1);
    Opened<PileTimerMT> without("stage", true);
    pileUp(without, 5);
    EXPECT_EQ(without.statistics().count, 1);
    Opened<PileTimerMT> pile("stage", true);
    xos_HostFail("xos_SemTake", 0, 1);
    pileUp(pile, 5);
    pileUp(pile, 6);
    EXPECT_EQ(pile.statistics().total, 11);
}

TEST_F(PileTimerMTOnHost, loses_nothing_of_many_threads) {
    constexpr int THREADS = 4;
    constexpr std::int64_t EACH = 5000;
    Opened<PileTimerMT> pile("stage", true);
    std::vector<std::thread> threads;
    for (int t = 0; t < THREADS; ++t) {
        threads.emplace_back([&pile] {
            for (std::int64_t i = 1; i <= EACH; ++i) pileUp(pile, i, i % 2);
        });
    }
    for (std::thread& thread : threads) thread.join();
    Statistics const statistics = pile.statistics();
    EXPECT_EQ(statistics.count, THREADS * EACH);
    EXPECT_EQ(statistics.total, THREADS * EACH * (EACH + 1) / 2);
    EXPECT_EQ(statistics.max, EACH);
    EXPECT_EQ(statistics.min, 1);
    EXPECT_EQ(statistics.minCount, 1) << "the first measurement of a thread takes 1 tick";
    EXPECT_EQ(statistics.suspendTotal, THREADS * EACH / 2);
    EXPECT_EQ(statistics.suspendMax, 1);
}

TEST_F(PileTimerMTOnHost, is_read_and_cleared_while_threads_pile) {
    Opened<PileTimerMT> pile("stage", true);
    std::thread worker([&pile] {
        for (int i = 0; i < 5000; ++i) {
            BaseTimer timer(true, false);
            timer.stop(&pile);
        }
    });
    BufStr<255> line;
    for (int i = 0; i < 500; ++i) {
        pile.print(line, 1'000'000);
        EXPECT_EQ(line.size(), 156u);
        pile.reset();
    }
    worker.join();
}
