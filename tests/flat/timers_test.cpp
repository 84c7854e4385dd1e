#include <zor_basis/flat.h>

#include "tests/support/scratch_root.h"
#include "tests/timers/assertions.h"
#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <iterator>
#include <string>
#include <thread>
#include <vector>

namespace fs = std::filesystem;
using namespace ZOR_Basis;

namespace {

std::ptrdiff_t reports() {
    fs::path const folder = scratchRoot() / "timer";
    return fs::exists(folder) ? std::distance(fs::directory_iterator(folder), fs::directory_iterator()) : 0;
}

/// How many measurements a timer has piled.
std::string count(PileTimer* timer) {
    BufStr<255> line;
    timer->print(line, 1);
    std::string const text(line.c_str() + 40, 9);
    return text.substr(text.find_last_of(' ') + 1);
}

} // namespace

TEST(FlatTimers, breathe) {
    zbTimerMgr* const manager = zbTimerMgrNew("flat", 2);
    zbPileTimer* const pile = zbTimerMgrCreate(manager, "stage", 2);
    zbTimerStart(pile);
    zbTimerStop(pile);
    EXPECT_EQ(count(pile), "1");
    EXPECT_EQ(zbTimerMgrGet(manager, 2), pile);
    EXPECT_EQ(zbTimerMgrGetMgr("flat"), manager);
    EXPECT_EQ(zbTimerMgrGetMgr("flats"), nullptr);
}

TEST(FlatTimers, measure_in_a_record_of_the_caller) {
    OpenedPile pile("stage", true);
    zbTimerDat record = {77, 78, 79, 80};
    zbTimerBaseStart(&record, 0);
    EXPECT_GT(record.start, 80);
    EXPECT_EQ(record.stop + record.suspendStart + record.suspended, 0);
    zbTimerBaseSuspend(&record);
    std::int64_t const suspension = record.suspendStart;
    EXPECT_GE(suspension, record.start);
    nextTick();
    zbTimerBaseSuspend(&record);
    EXPECT_EQ(record.suspendStart, suspension);
    zbTimerBaseResume(&record);
    EXPECT_EQ(record.suspendStart, 0);
    EXPECT_GT(record.suspended, 0);
    std::int64_t const suspended = record.suspended;
    zbTimerBaseResume(&record);
    EXPECT_EQ(record.suspended, suspended);
    zbTimerBaseStop(&record, &pile);
    EXPECT_TRUE(isIdle(record));
    EXPECT_EQ(pile.statistics().count, 1);
    EXPECT_EQ(pile.statistics().suspendTotal, suspended);

    zbTimerBaseStop(&record, &pile);
    EXPECT_EQ(pile.statistics().count, 1) << "it was idle";
    zbTimerBaseStart(&record, -1);
    EXPECT_GE(record.suspendStart, record.start);
    EXPECT_GT(record.start, 0);
}

TEST(FlatTimers, Kept_flat_01_a_running_record_is_restarted) {
    zbTimerDat record;
    zbTimerBaseStart(&record, 1);
    std::int64_t const start = record.start;
    nextTick();
    zbTimerBaseResume(&record);
    zbTimerBaseStart(&record, 0);
    EXPECT_GT(record.start, start);
    EXPECT_EQ(record.suspended, 0);
}

TEST(FlatTimers, Kept_flat_02_a_stop_without_a_pile_does_not_end_the_measurement) {
    OpenedPile pile("stage", true);
    zbTimerDat record;
    zbTimerBaseStart(&record, 0);
    std::int64_t const start = record.start;
    zbTimerBaseStop(&record, nullptr);
    EXPECT_EQ(record.start, start);
    EXPECT_EQ(record.stop, 0);
    zbTimerBaseStop(&record, &pile);
    EXPECT_EQ(pile.statistics().count, 1);
}

TEST(FlatTimers, drive_a_pile_with_its_complaints) {
    Assertions assertions;
    zbPileTimer* const pile = zbTimerMgrCreate(zbTimerMgrNew("complaints", 0), "stage", 0);
    zbTimerStart(pile);
    zbTimerStart(pile);
    EXPECT_EQ(assertions.take(), "183 zor_basis PileTimer::start() : already started;");
    zbTimerSuspend(pile);
    EXPECT_TRUE(pile->isSuspended());
    zbTimerSuspend(pile);
    EXPECT_EQ(assertions.take(), "197 zor_basis PileTimer::suspend() : already suspended;");
    zbTimerResume(pile);
    zbTimerResume(pile);
    EXPECT_EQ(assertions.take(), "204 zor_basis PileTimer::resume() : not suspended;");
    zbTimerStop(pile);
    zbTimerStop(pile);
    EXPECT_EQ(assertions.take(), "190 zor_basis PileTimer::start() : not started;");
    EXPECT_EQ(count(pile), "1");
}

TEST(FlatTimers, obey_the_switch_of_a_manager) {
    Assertions assertions;
    zbTimerMgr* const manager = zbTimerMgrNew("switch", 0);
    zbPileTimer* const pile = zbTimerMgrCreate(manager, "stage", 0);
    zbTimerMgrStart(manager, pile);
    EXPECT_FALSE(pile->started()) << "inactive";
    zbTimerStart(pile);
    EXPECT_TRUE(pile->started()) << "directly it runs";
    zbTimerMgrSuspend(manager, pile);
    EXPECT_FALSE(pile->isSuspended());
    zbTimerMgrStop(manager, pile);
    EXPECT_TRUE(pile->started());
    zbTimerStop(pile);

    zbTimerMgrSetActive(manager, -2);
    zbTimerMgrStart(manager, pile);
    zbTimerMgrSuspend(manager, pile);
    EXPECT_TRUE(pile->started() && pile->isSuspended());
    zbTimerMgrResume(manager, pile);
    EXPECT_FALSE(pile->isSuspended());
    zbTimerMgrStop(manager, pile);
    EXPECT_EQ(count(pile), "2");
    EXPECT_EQ(assertions.take(), "");
    zbTimerMgrStart(manager, pile);
    zbTimerMgrStart(manager, pile);
    EXPECT_NE(assertions.take(), "");
    zbTimerMgrSetActive(manager, 0);
    zbTimerMgrStop(manager, pile);
    EXPECT_TRUE(pile->started());
}

TEST(FlatTimers, report_and_reset) {
    zbTimerMgr* const manager = zbTimerMgrNew("resets", 0);
    zbPileTimer* const pile = zbTimerMgrCreate(manager, "stage", 0);
    pileUp(*pile, 5);
    zbTimerMgrReset(manager, 1);
    EXPECT_EQ(count(pile), "1") << "inactive";
    zbTimerMgrSetActive(manager, 1);
    zbTimerMgrReset(manager, 0);
    EXPECT_EQ(count(pile), "0");
    EXPECT_EQ(reports(), 0);
    zbTimerMgrReset(manager, 2);
    EXPECT_EQ(reports(), 1);
}

TEST(FlatTimers, share_one_pile_between_threads) {
    zbTimerMgr* const manager = zbTimerMgrNew("threads", 0);
    zbPileTimer* const pile = zbTimerMgrCreateMT(manager, "stage", 0);
    EXPECT_NE(dynamic_cast<PileTimerMT*>(pile), nullptr);
    EXPECT_EQ(dynamic_cast<PileTimerMT*>(zbTimerMgrCreate(manager, "stage", 0)), nullptr);
    std::vector<std::thread> threads;
    for (int t = 0; t < 3; ++t) {
        threads.emplace_back([pile] {
            for (int i = 0; i < 300; ++i) {
                zbTimerDat record;
                zbTimerBaseStart(&record, i % 2);
                zbTimerBaseStop(&record, pile);
            }
        });
    }
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(count(pile), "900");
}

TEST(FlatTimers, absorb_null) {
    Assertions assertions;
    OpenedPile pile("stage", true);
    zbTimerMgr* const manager = zbTimerMgrNew(nullptr, 0);
    zbTimerMgrSetActive(manager, 1);
    zbTimerBaseStart(nullptr, 1);
    zbTimerBaseStop(nullptr, &pile);
    zbTimerBaseSuspend(nullptr);
    zbTimerBaseResume(nullptr);
    for (auto* act : {zbTimerStart, zbTimerStop, zbTimerSuspend, zbTimerResume}) act(nullptr);
    for (auto* act : {zbTimerMgrStart, zbTimerMgrStop, zbTimerMgrSuspend, zbTimerMgrResume}) {
        act(nullptr, &pile);
        act(manager, nullptr);
        act(nullptr, nullptr);
    }
    zbTimerMgrSetActive(nullptr, 1);
    zbTimerMgrReset(nullptr, 1);
    EXPECT_EQ(zbTimerMgrGetMgr(nullptr), nullptr);
    EXPECT_EQ(zbTimerMgrCreate(nullptr, "stage", 0), nullptr);
    EXPECT_EQ(zbTimerMgrCreateMT(nullptr, "stage", 0), nullptr);
    EXPECT_EQ(zbTimerMgrGet(nullptr, 0), nullptr);
    EXPECT_EQ(zbTimerMgrGet(manager, 9), nullptr);
    EXPECT_FALSE(pile.started() || pile.isSuspended());
    EXPECT_EQ(assertions.take(), "");
}
