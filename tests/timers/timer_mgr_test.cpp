#include "basis/timers/timer_mgr_impl.h"
#include "zor_basis/timers.h"

#include <xos_host.h>

#include "tests/support/table.h"
#include "tests/timers/assertions.h"
#include "tests/timers/opened.h"
#include "tests/timers/scratch_root.h"

#include <gtest/gtest.h>

#include <atomic>
#include <string>
#include <thread>
#include <vector>

using namespace ZOR_Basis;

namespace {

constexpr char REGISTERED[] = "356 zor_basis TimerMgr::add() - already registered!;";

class TimerMgrTest : public testing::Test {
protected:
    ~TimerMgrTest() override { xos_HostFailClear(); }
};

/// How many measurements a timer has piled.
std::string count(PileTimer* timer) {
    BufStr<255> line;
    timer->print(line, 1);
    std::string const text(line.c_str() + 40, 9);
    return text.substr(text.find_last_of(' ') + 1);
}

} // namespace

TEST_F(TimerMgrTest, breathes) {
    TimerMgr* const manager = TimerMgr::New("breathing", 0);
    ASSERT_NE(manager, nullptr);
    EXPECT_FALSE(manager->active());
    PileTimer* const timer = TimerMgr::create(manager, "stage", 0, false);
    manager->setActive(true);
    manager->start(timer);
    manager->stop(timer);
    EXPECT_EQ(count(timer), "1");
    manager->reset(false);
    EXPECT_EQ(count(timer), "0");
    EXPECT_FALSE(std::filesystem::exists(scratchRoot() / "timer" / "breathing"));
}

TEST_F(TimerMgrTest, gives_ids) {
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
            EXPECT_EQ(assertions.take(), before != nullptr ? REGISTERED : "");
            delete before;
        }
    }
}

TEST_F(TimerMgrTest, finds_nothing_in_empty_slots_and_beyond) {
    TimerMgrImpl manager("slots", 5);
    PileTimer* const timer = manager.createTimer("timer", 3, false);
    for (std::uint64_t id : {0ull, 2ull, 4ull, 5ull, 6ull, 100ull, ~0ull}) {
        EXPECT_EQ(TimerMgr::get(&manager, id), nullptr) << id;
    }
    EXPECT_EQ(TimerMgr::get(&manager, 3), timer);
    EXPECT_EQ(TimerMgr::get(nullptr, 3), nullptr);
    EXPECT_EQ(TimerMgr::create(nullptr, "timer", 3, true), nullptr);
}

TEST_F(TimerMgrTest, makes_timers_that_check_of_the_kind_that_is_asked_for) {
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

TEST_F(TimerMgrTest, Kept_timers_09_a_displaced_timer_stays_alive) {
    Assertions assertions;
    PileTimer* first = nullptr;
    {
        TimerMgrImpl manager("displaced", 5);
        first = manager.createTimer("first", 3, true);
        PileTimer* const second = manager.createTimer("second", 3, false);
        EXPECT_EQ(assertions.take(), REGISTERED);
        EXPECT_EQ(manager.getTimer(3), second);
        EXPECT_EQ(second->id(), 3u);
        manager.setActive(true);
        pileUp(*first, 5);
        manager.reset(false);
        EXPECT_EQ(count(first), "1") << "its manager knows it no longer";
    }
    EXPECT_STREQ(first->cname(), "first");
    delete first;
}

TEST_F(TimerMgrTest, deletes_its_timers_and_its_semaphore) {
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

TEST_F(TimerMgrTest, drives_timers_by_id_and_directly_while_it_is_active) {
    Assertions assertions;
    TimerMgrImpl manager("drives", 5);
    PileTimer* const timer = manager.createTimer("timer", 3, false);
    enum Id { STAGE = 3 };
    std::uint64_t const id = 3;
    auto const all = [&](auto const& how) {
        manager.start(how);
        bool const started = timer->started();
        manager.suspend(how);
        bool const suspended = timer->isSuspended();
        manager.resume(how);
        bool const resumed = started && !timer->isSuspended();
        manager.stop(how);
        return started && suspended && resumed && !timer->started();
    };
    EXPECT_FALSE(all(id) || all(3) || all(3u) || all(STAGE) || all(timer)) << "inactive";
    EXPECT_EQ(count(timer), "0");
    manager.setActive(true);
    EXPECT_TRUE(all(id) && all(3) && all(3u) && all(3l) && all(STAGE) && all(timer));
    EXPECT_EQ(count(timer), "6");
    EXPECT_EQ(assertions.take(), "");

    manager.start(4);
    manager.stop(-1);
    manager.suspend(1000u);
    manager.resume(~std::uint64_t{0});
    manager.start(static_cast<PileTimer*>(nullptr));
    manager.stop(static_cast<PileTimer*>(nullptr));
    manager.suspend(static_cast<PileTimer*>(nullptr));
    manager.resume(static_cast<PileTimer*>(nullptr));
    EXPECT_EQ(assertions.take(), "") << "no timer, no complaint";
    manager.stop(3);
    EXPECT_EQ(assertions.take(), "190 zor_basis PileTimer::start() : not started;");

    TimerMgr::start(&manager, id);
    TimerMgr::suspend(&manager, id);
    EXPECT_TRUE(timer->started() && timer->isSuspended());
    TimerMgr::resume(&manager, id);
    EXPECT_FALSE(timer->isSuspended());
    TimerMgr::stop(&manager, id);
    EXPECT_EQ(count(timer), "7");
    TimerMgr::start(&manager, timer);
    TimerMgr::suspend(&manager, timer);
    EXPECT_TRUE(timer->started() && timer->isSuspended());
    TimerMgr::resume(&manager, timer);
    TimerMgr::stop(&manager, timer);
    EXPECT_EQ(count(timer), "8");
    TimerMgr::start(&manager, 99);
    TimerMgr::start(&manager, 99U);
    TimerMgr::start(&manager, static_cast<PileTimer*>(nullptr));
    TimerMgr::start(nullptr, timer);
    TimerMgr::suspend(nullptr, timer);
    TimerMgr::resume(nullptr, timer);
    TimerMgr::stop(nullptr, timer);
    EXPECT_EQ(count(timer), "8");
    TimerMgr::start(nullptr, id);
    TimerMgr::suspend(nullptr, id);
    TimerMgr::resume(nullptr, id);
    TimerMgr::stop(nullptr, id);
    TimerMgr::reset(nullptr, true);
    TimerMgr::reset(&manager, false);
    EXPECT_EQ(count(timer), "0");
}

TEST_F(TimerMgrTest, resets_only_while_active) {
    TimerMgrImpl manager("resets", 0);
    PileTimer* const timer = manager.createTimer("timer", 0, false);
    pileUp(*timer, 5);
    manager.reset(false);
    EXPECT_EQ(count(timer), "1");
    manager.resetTimers(false);
    EXPECT_EQ(count(timer), "0") << "asked directly it resets at any time";
}

TEST_F(TimerMgrTest, is_found_by_name_the_first_made_first) {
    TimerMgr* const first = TimerMgr::New("twice", 0);
    TimerMgr* const second = TimerMgr::New("twice", 4);
    EXPECT_NE(first, second);
    EXPECT_EQ(TimerMgr::Get("twice"), first);
    EXPECT_EQ(TimerMgr::Get(std::string("twice").c_str()), first);
    EXPECT_EQ(TimerMgr::Get("twic"), nullptr);
    EXPECT_EQ(TimerMgr::Get("twice "), nullptr);
    EXPECT_EQ(TimerMgr::Get(nullptr), nullptr);
    TimerMgr* const nameless = TimerMgr::New(nullptr, 0);
    EXPECT_EQ(TimerMgr::Get(""), nameless);
    EXPECT_EQ(TimerMgr::Get(nullptr), nullptr);
    std::vector<TimerMgr*> many;
    for (int i = 0; i < 20; ++i) many.push_back(TimerMgr::New(("many" + std::to_string(i)).c_str(), 0));
    for (int i = 0; i < 20; ++i) EXPECT_EQ(TimerMgr::Get(("many" + std::to_string(i)).c_str()), many[i]);
}

TEST_F(TimerMgrTest, works_without_semaphores_and_gives_back_only_what_it_took) {
    xos_HostFail("xos_SemMCreate", 0, 2);
    TimerMgrImpl without("without", 0);
    PileTimer* const timer = without.createTimer("timer", 0, true);
    pileUp(*timer, 5);
    EXPECT_EQ(count(timer), "1");
    without.resetTimers(false);
    EXPECT_EQ(count(timer), "0");

    TimerMgrImpl manager("takes", 0);
    xos_HostFail("xos_SemTake", 0, 2);
    xos_HostCallsReset();
    PileTimer* const other = manager.createTimer("timer", 0, false);
    pileUp(*other, 5);
    manager.resetTimers(false);
    EXPECT_EQ(count(other), "0");
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 0u);
    manager.resetTimers(false);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 1u);
}

TEST_F(TimerMgrTest, takes_whatever_converts_to_an_id_or_a_timer_for_managers_that_may_be_null) {
    void (*const stated)(TimerMgr*, std::uint64_t) = TimerMgr::start;
    TimerMgr* const manager = TimerMgr::New("converting", 5);
    manager->setActive(true);
    PileTimer* const timer = TimerMgr::create(manager, "stage", 3, false);
    std::atomic<std::uint64_t> const sharedId{3};
    std::atomic<int> const sharedNumber{3};
    enum Stage { LOAD, PARSE, RENDER, PRINT };
    PileTimerAuto driver(timer, manager, false, false);
    for (TimerMgr* which : {manager, static_cast<TimerMgr*>(nullptr)}) {
        auto const measure = [which](auto&& stage) {
            TimerMgr::start(which, stage);
            TimerMgr::suspend(which, stage);
            TimerMgr::resume(which, stage);
            TimerMgr::stop(which, stage);
        };
        measure(sharedId);
        measure(sharedNumber);
        measure(driver);
        measure(PRINT);
        measure(3);
        measure(3u);
        measure(std::uint64_t{3});
        measure(std::int8_t{3});
        measure(timer);
        measure(nullptr);
        EXPECT_EQ(count(timer), "9") << "for no manager nothing happens";
    }
    TimerMgr::start(manager, 0);
    EXPECT_EQ(count(timer), "9") << "a literal 0 is an id";
    stated(manager, 3);
    TimerMgr::stop(manager, 3);
    EXPECT_EQ(count(timer), "10");
}

TEST_F(TimerMgrTest, finds_timers_that_another_thread_creates_in_reserved_slots) {
    constexpr std::uint64_t LAST = 500;
    TimerMgr* const manager = TimerMgr::New("growing within", LAST);
    std::vector<std::thread> finders;
    std::atomic<int> found{0};
    for (int i = 0; i < 3; ++i) {
        finders.emplace_back([&] {
            for (std::uint64_t id = 1; id <= LAST; ++id) {
                PileTimer* timer = nullptr;
                while ((timer = TimerMgr::get(manager, id)) == nullptr) std::this_thread::yield();
                found += timer->id() == id && timer->name() == std::to_string(id) ? 1 : 0;
            }
        });
    }
    for (std::uint64_t id = 1; id <= LAST; ++id) manager->createTimer(std::to_string(id).c_str(), id, false);
    for (std::thread& finder : finders) finder.join();
    EXPECT_EQ(found, 3 * int{LAST});
}

TEST_F(TimerMgrTest, serves_many_threads) {
    constexpr int THREADS = 4, EACH = 50;
    TimerMgr* const manager = TimerMgr::New("threads", THREADS);
    std::atomic<bool> go{false};
    std::vector<std::thread> threads;
    for (int t = 0; t < THREADS; ++t) {
        threads.emplace_back([&go, manager, t] {
            while (!go) std::this_thread::yield();
            for (int i = 0; i < EACH; ++i) {
                TimerMgr::New(("thread" + std::to_string(t)).c_str(), 0);
                EXPECT_EQ(TimerMgr::Get("threads"), manager);
                manager->createTimer("timer", 0, true);
                manager->setActive(i % 2 == 0);
                manager->reset(false);
            }
        });
    }
    go = true;
    for (std::thread& thread : threads) thread.join();
    std::uint64_t timers = 0;
    for (std::uint64_t id = 0; id < 1000; ++id) timers += manager->getTimer(id) != nullptr ? 1 : 0;
    EXPECT_EQ(timers, std::uint64_t{THREADS} * EACH);
    EXPECT_EQ(manager->getTimer(THREADS), nullptr);
}
