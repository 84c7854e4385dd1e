#include <zor_basis/timers.h>

#include "tests/support/table.h"
#include "tests/timers/assertions.h"
#include "tests/timers/complaints.h"
#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <array>
#include <string>
#include <vector>

using namespace ZOR_Basis;

TEST(PileTimer, breathes) {
    OpenedPile pile("render page", true);
    EXPECT_STREQ(pile.cname(), "render page");
    EXPECT_EQ(pile.name(), "render page");
    EXPECT_EQ(pile.id(), 0u);
    EXPECT_TRUE(isIdle(pile));
    EXPECT_EQ(pile.statistics(), Statistics{});
    pile.start(false);
    pile.suspend();
    nextTick();
    pile.resume();
    pile.stop();
    EXPECT_TRUE(isIdle(pile));
    Statistics const statistics = pile.statistics();
    EXPECT_EQ(statistics.count, 1);
    EXPECT_GE(statistics.total, statistics.suspendTotal);
    EXPECT_GT(statistics.suspendTotal, 0);
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

namespace {

struct Piled {
    Row row;
    std::vector<std::array<std::int64_t, 2>> measurements; // elapsed, suspended
    Statistics expected;
};

Piled const PILED[] = {
    {{}, {{7, 0}}, {.count = 1, .total = 7, .max = 7, .maxCount = 1, .min = 7, .minCount = 1}},
    {{}, {{5, 0}, {9, 0}, {9, 0}, {3, 0}}, {.count = 4, .total = 26, .max = 9, .maxCount = 2, .min = 3, .minCount = 4}},
    // The first of two equal measurements keeps its place.
    {{}, {{3, 0}, {3, 0}}, {.count = 2, .total = 6, .max = 3, .maxCount = 1, .min = 3, .minCount = 1}},
    {{},
     {{9, 2}, {8, 0}, {7, 5}, {6, 5}},
     {.count = 4, .total = 30, .max = 9, .maxCount = 1, .min = 6, .minCount = 4, .suspendTotal = 12, .suspendMax = 5}},
    // Suspended before the start.
    {{},
     {{4, 9}},
     {.count = 1, .total = 4, .max = 4, .maxCount = 1, .min = 4, .minCount = 1, .suspendTotal = 9, .suspendMax = 9}},
    {{}, {{-3, 0}}, {.count = 1, .total = -3, .min = -3, .minCount = 1}},
    {{}, {{4, -2}}, {.count = 1, .total = 4, .max = 4, .maxCount = 1, .min = 4, .minCount = 1, .suspendTotal = -2}},
    {{}, {{0, 0}}, {.count = 1, .minCount = 1}},
};

} // namespace

TEST(PileTimer, piles_up_statistics) {
    for (Piled const& c : PILED) {
        SCOPED_TRACE(c.row);
        OpenedPile pile("stage", true);
        for (auto const& [elapsed, suspended] : c.measurements) pileUp(pile, elapsed, suspended);
        EXPECT_EQ(pile.statistics(), c.expected);
    }
}

TEST(PileTimer, Kept_timers_05_a_shortest_time_of_0_is_replaced_by_the_next) {
    OpenedPile pile("stage", true);
    for (std::int64_t elapsed : {5, 0, 8, 9}) pileUp(pile, elapsed);
    EXPECT_EQ(pile.statistics(),
              (Statistics{.count = 4, .total = 22, .max = 9, .maxCount = 4, .min = 8, .minCount = 3}));
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
    EXPECT_EQ(pile.statistics().count, 1);
}

namespace {

struct Misuse {
    Row row;
    char const* operations; // s start(false), S start(true), p stop, u suspend, r resume
    std::string heard;
    bool started, suspended;
    std::int64_t count;
};

Misuse const MISUSES[] = {
    {{}, "sp", "", false, false, 1},
    {{}, "ss", ALREADY_STARTED, true, false, 0},
    {{}, "sS", ALREADY_STARTED, true, true, 0}, // suspends nonetheless
    {{}, "p", NOT_STARTED, false, false, 0},
    {{}, "spp", NOT_STARTED, false, false, 1},
    {{}, "u", "", false, true, 0}, // a suspension before the start is no misuse
    {{}, "uu", ALREADY_SUSPENDED, false, true, 0},
    {{}, "Su", ALREADY_SUSPENDED, true, true, 0},
    {{}, "us", "", true, true, 0},
    {{}, "uS", "", true, true, 0}, // it is suspended already
    {{}, "r", NOT_SUSPENDED, false, false, 0},
    {{}, "sr", NOT_SUSPENDED, true, false, 0},
    {{}, "surr", NOT_SUSPENDED, true, false, 0},
    {{}, "Sp", "", false, false, 1},
    {{}, "up", NOT_STARTED, false, true, 0},
};

void operate(PileTimer& pile, char operation) {
    switch (operation) {
    case 's':
        return pile.start(false);
    case 'S':
        return pile.start(true);
    case 'p':
        return pile.stop();
    case 'u':
        return pile.suspend();
    default:
        return pile.resume();
    }
}

} // namespace

TEST(PileTimer, complains_of_misuse_and_goes_on) {
    for (Misuse const& c : MISUSES) {
        SCOPED_TRACE(c.row);
        for (bool checks : {true, false}) {
            Assertions assertions;
            OpenedPile pile("stage", checks);
            for (char operation : std::string(c.operations)) operate(pile, operation);
            EXPECT_EQ(assertions.take(), checks ? c.heard : "") << checks;
            EXPECT_EQ(pile.started(), c.started);
            EXPECT_EQ(pile.isSuspended(), c.suspended);
            EXPECT_EQ(pile.statistics().count, c.count);
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
    EXPECT_EQ(pile.statistics(), Statistics{});
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
        EXPECT_EQ(copy->statistics(), original.statistics());
        EXPECT_EQ(copy->id(), 12u);
        EXPECT_STREQ(copy->cname(), "stage");
        EXPECT_NE(copy->cname(), original.cname());
        EXPECT_EQ(copy->zbTimerDat::start, original.zbTimerDat::start);
        EXPECT_EQ(copy->suspendStart, original.suspendStart);
    }
    assigned.start(false);
    EXPECT_EQ(assertions.take(), ALREADY_STARTED) << "the copy checks, too";
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
    EXPECT_EQ(pile.statistics().count, 1);
    PileTimer::reset(&pile);
    EXPECT_EQ(pile.statistics().count, 0);
}
