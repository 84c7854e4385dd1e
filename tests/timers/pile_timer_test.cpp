#include <zor_basis/timers.h>

#include <xos_host.h>

#include "tests/support/table.h"
#include "tests/timers/assertions.h"
#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <array>
#include <string>
#include <thread>
#include <type_traits>
#include <vector>

using namespace ZOR_Basis;

namespace {

using Numbers = std::array<std::int64_t, 8>; // count, total, max, maxCount, min, minCount, suspendTotal, suspendMax

constexpr char ALREADY_STARTED[] = "183 zor_basis PileTimer::start() : already started;";
constexpr char NOT_STARTED[] = "190 zor_basis PileTimer::start() : not started;";
constexpr char ALREADY_SUSPENDED[] = "197 zor_basis PileTimer::suspend() : already suspended;";
constexpr char NOT_SUSPENDED[] = "204 zor_basis PileTimer::resume() : not suspended;";

class PileTimerMTTest : public testing::Test {
protected:
    ~PileTimerMTTest() override { xos_HostFailClear(); }
};

} // namespace

TEST(PileTimer, breathes) {
    OpenedPile pile("render page", true);
    EXPECT_STREQ(pile.cname(), "render page");
    EXPECT_EQ(pile.name(), "render page");
    EXPECT_EQ(pile.id(), 0u);
    EXPECT_TRUE(isIdle(pile));
    EXPECT_EQ(pile.numbers(), Numbers{});
    pile.start(false);
    pile.suspend();
    nextTick();
    pile.resume();
    pile.stop();
    EXPECT_TRUE(isIdle(pile));
    auto const numbers = pile.numbers();
    EXPECT_EQ(numbers[0], 1);
    EXPECT_GE(numbers[1], numbers[6]);
    EXPECT_GT(numbers[6], 0);
}

TEST(PileTimer, has_a_name_of_its_own) {
    char name[] = "abc";
    PileTimer const pile(name, false);
    name[0] = 'x';
    EXPECT_STREQ(pile.cname(), "abc");
    EXPECT_EQ(PileTimer(nullptr, false).cname(), Str::StrEmpty);
    EXPECT_EQ(PileTimer("", false).cname(), Str::StrEmpty);
}

TEST(PileTimer, equals_by_name_alone) {
    OpenedPile a("same", true), b("same", false), c("other", true), longer("same and more", true);
    pileUp(a, 5);
    a.setId(7);
    EXPECT_TRUE(a.eq(b));
    EXPECT_FALSE(a.eq(c));
    EXPECT_FALSE(a.eq(longer));
    EXPECT_TRUE(PileTimer(nullptr, true).eq(PileTimer("", true)));
}

TEST(PileTimer, piles_up_statistics) {
    struct Case {
        Row row;
        std::vector<std::array<std::int64_t, 2>> measurements; // elapsed, suspended
        Numbers expected;
    };
    for (Case const& c : {
             Case{{}, {{7, 0}}, {1, 7, 7, 1, 7, 1, 0, 0}},
             Case{{}, {{5, 0}, {9, 0}, {9, 0}, {3, 0}}, {4, 26, 9, 2, 3, 4, 0, 0}},
             Case{{}, {{3, 0}, {3, 0}}, {2, 6, 3, 1, 3, 1, 0, 0}}, // the first keeps its place
             Case{{}, {{9, 2}, {8, 0}, {7, 5}, {6, 5}}, {4, 30, 9, 1, 6, 4, 12, 5}},
             Case{{}, {{4, 9}}, {1, 4, 4, 1, 4, 1, 9, 9}}, // suspended before the start
             Case{{}, {{-3, 0}}, {1, -3, 0, 0, -3, 1, 0, 0}},
             Case{{}, {{4, -2}}, {1, 4, 4, 1, 4, 1, -2, 0}},
             Case{{}, {{0, 0}}, {1, 0, 0, 0, 0, 1, 0, 0}},
         }) {
        SCOPED_TRACE(c.row);
        OpenedPile pile("stage", true);
        for (auto const& [elapsed, suspended] : c.measurements) pileUp(pile, elapsed, suspended);
        EXPECT_EQ(pile.numbers(), c.expected);
    }
}

TEST(PileTimer, Kept_timers_05_a_shortest_time_of_0_is_replaced_by_the_next) {
    OpenedPile pile("stage", true);
    for (std::int64_t elapsed : {5, 0, 8, 9}) pileUp(pile, elapsed);
    EXPECT_EQ(pile.numbers(), (Numbers{4, 22, 9, 4, 8, 3, 0, 0}));
}

TEST(PileTimer, makes_idle_what_it_piles_and_leaves_alone_what_was_not_started) {
    OpenedPile pile("stage", true);
    BaseTimer timer = finished(5, 2);
    pile.addTotal(timer);
    EXPECT_TRUE(isIdle(timer));
    for (std::int64_t start : {0, -1}) {
        static_cast<zbTimerDat&>(timer) = {start, 20, 3, 4};
        pile.addTotal(timer);
        EXPECT_EQ(timer.zbTimerDat::stop, 20);
        EXPECT_EQ(timer.suspended(), 4);
    }
    EXPECT_EQ(pile.numbers()[0], 1);
}

TEST(PileTimer, complains_of_misuse_and_goes_on) {
    struct Case {
        Row row;
        char const* operations; // s start(false), S start(true), p stop, u suspend, r resume
        std::string heard;
        bool started, suspended;
        std::int64_t count;
    };
    for (Case const& c : {
             Case{{}, "sp", "", false, false, 1},
             Case{{}, "ss", ALREADY_STARTED, true, false, 0},
             Case{{}, "sS", ALREADY_STARTED, true, true, 0}, // suspends nonetheless
             Case{{}, "p", NOT_STARTED, false, false, 0},
             Case{{}, "spp", NOT_STARTED, false, false, 1},
             Case{{}, "u", "", false, true, 0}, // before the start is no misuse
             Case{{}, "uu", ALREADY_SUSPENDED, false, true, 0},
             Case{{}, "Su", ALREADY_SUSPENDED, true, true, 0},
             Case{{}, "us", "", true, true, 0},
             Case{{}, "uS", "", true, true, 0}, // it is suspended already
             Case{{}, "r", NOT_SUSPENDED, false, false, 0},
             Case{{}, "sr", NOT_SUSPENDED, true, false, 0},
             Case{{}, "surr", NOT_SUSPENDED, true, false, 0},
             Case{{}, "Sp", "", false, false, 1},
             Case{{}, "up", NOT_STARTED, false, true, 0},
         }) {
        SCOPED_TRACE(c.row);
        for (bool checks : {true, false}) {
            Assertions assertions;
            OpenedPile pile("stage", checks);
            for (char const* operation = c.operations; *operation != '\0'; ++operation) {
                switch (*operation) {
                case 's':
                    pile.start(false);
                    break;
                case 'S':
                    pile.start(true);
                    break;
                case 'p':
                    pile.stop();
                    break;
                case 'u':
                    pile.suspend();
                    break;
                default:
                    pile.resume();
                }
            }
            EXPECT_EQ(assertions.take(), checks ? c.heard : "") << checks;
            EXPECT_EQ(pile.started(), c.started);
            EXPECT_EQ(pile.isSuspended(), c.suspended);
            EXPECT_EQ(pile.numbers()[0], c.count);
        }
    }
}

TEST(PileTimer, Kept_timers_04_a_stop_complains_in_the_name_of_start) {
    Assertions assertions;
    PileTimer("stage", true).stop();
    EXPECT_EQ(assertions.take(), NOT_STARTED);
}

TEST(PileTimer, that_is_started_twice_keeps_the_first_start) {
    Assertions assertions;
    OpenedPile pile("stage", true);
    pile.start(false);
    std::int64_t const start = pile.zbTimerDat::start;
    nextTick();
    pile.start(false);
    EXPECT_EQ(pile.zbTimerDat::start, start);
}

TEST(PileTimer, resumes_after_its_complaint_where_the_record_asks_for_it) {
    Assertions assertions;
    PileTimer pile("stage", true);
    pile.suspendStart = -1000; // not suspended, and not 0 either
    pile.resume();
    EXPECT_EQ(assertions.take(), NOT_SUSPENDED);
    EXPECT_EQ(pile.suspendStart, 0);
    EXPECT_GT(pile.suspended(), 1000);
}

TEST(PileTimer, clears_all_but_id_checks_and_name) {
    Assertions assertions;
    OpenedPile pile("stage", true);
    pileUp(pile, 5, 2);
    pile.setId(12);
    pile.start(true);
    pile.reset();
    EXPECT_TRUE(isIdle(pile));
    EXPECT_EQ(pile.numbers(), Numbers{});
    EXPECT_EQ(pile.id(), 12u);
    EXPECT_STREQ(pile.cname(), "stage");
    EXPECT_EQ(assertions.take(), "");
    pile.stop();
    EXPECT_EQ(assertions.take(), NOT_STARTED) << "it still checks";
}

TEST(PileTimer, copies_everything) {
    Assertions assertions;
    OpenedPile original("stage", true);
    pileUp(original, 5, 2);
    original.setId(12);
    original.start(true);
    OpenedPile const made(original);
    OpenedPile assigned("other name that is longer", false);
    pileUp(assigned, 70);
    assigned = original;
    for (OpenedPile const* copy : {&made, static_cast<OpenedPile const*>(&assigned)}) {
        EXPECT_EQ(copy->numbers(), original.numbers());
        EXPECT_EQ(copy->id(), 12u);
        EXPECT_STREQ(copy->cname(), "stage");
        EXPECT_NE(copy->cname(), original.cname());
        EXPECT_EQ(copy->zbTimerDat::start, original.zbTimerDat::start);
        EXPECT_EQ(copy->suspendStart, original.suspendStart);
    }
    assigned.start(false);
    EXPECT_EQ(assertions.take(), ALREADY_STARTED) << "the checks went over";
}

TEST(PileTimer, absorbs_null) {
    PileTimer* const none = nullptr;
    PileTimer::start(none, true);
    PileTimer::suspend(none);
    PileTimer::resume(none);
    PileTimer::stop(none);
    PileTimer::reset(none);
    OpenedPile pile("stage", false);
    PileTimer::start(&pile, true);
    EXPECT_TRUE(pile.isSuspended());
    PileTimer::resume(&pile);
    EXPECT_FALSE(pile.isSuspended());
    PileTimer::suspend(&pile);
    EXPECT_TRUE(pile.isSuspended());
    PileTimer::stop(&pile);
    EXPECT_EQ(pile.numbers()[0], 1);
    PileTimer::reset(&pile);
    EXPECT_EQ(pile.numbers()[0], 0);
}

TEST_F(PileTimerMTTest, holds_its_mutex_around_each_piling) {
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

TEST_F(PileTimerMTTest, piles_without_a_mutex_that_cannot_be_made_or_taken) {
    xos_HostFail("xos_SemMCreate", 0, 1);
    Opened<PileTimerMT> without("stage", true);
    pileUp(without, 5);
    EXPECT_EQ(without.numbers()[0], 1);
    Opened<PileTimerMT> pile("stage", true);
    xos_HostFail("xos_SemTake", 0, 1);
    pileUp(pile, 5);
    pileUp(pile, 6);
    EXPECT_EQ(pile.numbers()[1], 11);
}

TEST_F(PileTimerMTTest, loses_nothing_of_many_threads) {
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
    auto const numbers = pile.numbers();
    EXPECT_EQ(numbers[0], THREADS * EACH);
    EXPECT_EQ(numbers[1], THREADS * EACH * (EACH + 1) / 2);
    EXPECT_EQ(numbers[2], EACH);
    EXPECT_EQ(numbers[4], 1);
    EXPECT_EQ(numbers[5], 1) << "the first of all is one of 1 tick";
    EXPECT_EQ(numbers[6], THREADS * EACH / 2);
    EXPECT_EQ(numbers[7], 1);
}

TEST_F(PileTimerMTTest, is_read_and_cleared_while_threads_pile) {
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
