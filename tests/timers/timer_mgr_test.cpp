#include "basis/timers/timer_mgr_impl.h"
#include "zor_basis/timers.h"

#include "tests/support/scratch_root.h"
#include "tests/timers/assertions.h"
#include "tests/timers/complaints.h"
#include "tests/timers/opened.h"

#include <gtest/gtest.h>

#include <atomic>
#include <string>
#include <thread>
#include <vector>

using namespace ZOR_Basis;

TEST(TimerMgr, breathes) {
    TimerMgr* const manager = TimerMgr::New("breathing", 0);
    ASSERT_NE(manager, nullptr);
    EXPECT_FALSE(manager->active());
    PileTimer* const timer = TimerMgr::create(manager, "stage", 0, false);
    manager->setActive(true);
    manager->start(timer);
    manager->stop(timer);
    EXPECT_EQ(countOf(timer), "1");
    manager->reset(false);
    EXPECT_EQ(countOf(timer), "0");
    EXPECT_FALSE(std::filesystem::exists(scratchRoot() / "timer" / "breathing"));
}

TEST(TimerMgr, finds_nothing_in_empty_slots_and_beyond) {
    TimerMgrImpl manager("slots", 5);
    PileTimer* const timer = manager.createTimer("timer", 3, false);
    for (std::uint64_t id : {0ull, 2ull, 4ull, 5ull, 6ull, 100ull, ~0ull}) {
        EXPECT_EQ(TimerMgr::get(&manager, id), nullptr) << id;
    }
    EXPECT_EQ(TimerMgr::get(&manager, 3), timer);
    EXPECT_EQ(TimerMgr::get(nullptr, 3), nullptr);
    EXPECT_EQ(TimerMgr::create(nullptr, "timer", 3, true), nullptr);
}

namespace {

/// Measures once, with a suspension. \return whether each step had its effect
template <class How>
bool measured(TimerMgr& manager, PileTimer const& timer, How const& how) {
    manager.start(how);
    bool const started = timer.started();
    manager.suspend(how);
    bool const suspended = timer.isSuspended();
    manager.resume(how);
    bool const resumed = started && !timer.isSuspended();
    manager.stop(how);
    return started && suspended && resumed && !timer.started();
}

/// A manager with one timer of the id 3.
struct OneTimer {
    static constexpr std::uint64_t ID = 3;
    TimerMgrImpl manager{"drives", 5};
    PileTimer* const timer = manager.createTimer("timer", ID, false);
    PileTimer* const none = nullptr;
};

} // namespace

TEST(TimerMgr, drives_timers_by_id_and_directly_while_it_is_active) {
    OneTimer one;
    auto const all = [&one](auto const& how) { return measured(one.manager, *one.timer, how); };
    enum Id { STAGE = 3 };
    EXPECT_FALSE(all(one.ID) || all(3) || all(3u) || all(STAGE) || all(one.timer)) << "inactive";
    EXPECT_EQ(countOf(one.timer), "0");
    one.manager.setActive(true);
    Assertions assertions;
    EXPECT_TRUE(all(one.ID) && all(3) && all(3u) && all(3l) && all(STAGE) && all(one.timer));
    EXPECT_EQ(countOf(one.timer), "6");
    EXPECT_EQ(assertions.take(), "");
}

TEST(TimerMgr, ignores_ids_without_a_timer_and_null) {
    Assertions assertions;
    OneTimer one;
    one.manager.setActive(true);
    one.manager.start(4);
    one.manager.stop(-1);
    one.manager.suspend(1000u);
    one.manager.resume(~std::uint64_t{0});
    one.manager.start(one.none);
    one.manager.stop(one.none);
    one.manager.suspend(one.none);
    one.manager.resume(one.none);
    EXPECT_EQ(assertions.take(), "") << "no timer, no complaint";
    one.manager.stop(3);
    EXPECT_EQ(assertions.take(), NOT_STARTED);
}

TEST(TimerMgr, drives_timers_for_a_manager_that_may_be_null) {
    OneTimer one;
    one.manager.setActive(true);
    TimerMgr::start(&one.manager, one.ID);
    TimerMgr::suspend(&one.manager, one.ID);
    EXPECT_TRUE(one.timer->started() && one.timer->isSuspended());
    TimerMgr::resume(&one.manager, one.ID);
    EXPECT_FALSE(one.timer->isSuspended());
    TimerMgr::stop(&one.manager, one.ID);
    EXPECT_EQ(countOf(one.timer), "1");
    TimerMgr::start(&one.manager, one.timer);
    TimerMgr::suspend(&one.manager, one.timer);
    EXPECT_TRUE(one.timer->started() && one.timer->isSuspended());
    TimerMgr::resume(&one.manager, one.timer);
    TimerMgr::stop(&one.manager, one.timer);
    EXPECT_EQ(countOf(one.timer), "2");
    TimerMgr::start(&one.manager, 99);
    TimerMgr::start(&one.manager, 99U);
    TimerMgr::start(&one.manager, one.none);
    EXPECT_EQ(countOf(one.timer), "2");
}

TEST(TimerMgr, does_nothing_for_a_manager_that_is_null) {
    OneTimer one;
    one.manager.setActive(true);
    pileUp(*one.timer, 5);
    TimerMgr::start(nullptr, one.timer);
    TimerMgr::suspend(nullptr, one.timer);
    TimerMgr::resume(nullptr, one.timer);
    TimerMgr::stop(nullptr, one.timer);
    TimerMgr::start(nullptr, one.ID);
    TimerMgr::suspend(nullptr, one.ID);
    TimerMgr::resume(nullptr, one.ID);
    TimerMgr::stop(nullptr, one.ID);
    TimerMgr::reset(nullptr, true);
    EXPECT_EQ(countOf(one.timer), "1");
    TimerMgr::reset(&one.manager, false);
    EXPECT_EQ(countOf(one.timer), "0");
}

namespace {

template <class Stage>
void measure(TimerMgr* manager, Stage&& stage) {
    TimerMgr::start(manager, stage);
    TimerMgr::suspend(manager, stage);
    TimerMgr::resume(manager, stage);
    TimerMgr::stop(manager, stage);
}

/// Measures with every type that converts to the id 3 or to the timer, and once with null.
void measureByAllTypes(TimerMgr* manager, PileTimer* timer, PileTimerAuto& driver) {
    enum Stage { LOAD, PARSE, RENDER, PRINT };
    std::atomic<std::uint64_t> const sharedId{3};
    std::atomic<int> const sharedNumber{3};
    measure(manager, sharedId);
    measure(manager, sharedNumber);
    measure(manager, driver);
    measure(manager, PRINT);
    measure(manager, 3);
    measure(manager, 3u);
    measure(manager, std::uint64_t{3});
    measure(manager, std::int8_t{3});
    measure(manager, timer);
    measure(manager, nullptr);
}

} // namespace

TEST(TimerMgr, takes_whatever_converts_to_an_id_or_a_timer) {
    void (*const stated)(TimerMgr*, std::uint64_t) = TimerMgr::start;
    OneTimer one;
    one.manager.setActive(true);
    PileTimerAuto driver(one.timer, &one.manager, false, false);
    measureByAllTypes(&one.manager, one.timer, driver);
    EXPECT_EQ(countOf(one.timer), "9");
    measureByAllTypes(nullptr, one.timer, driver);
    EXPECT_EQ(countOf(one.timer), "9") << "for no manager nothing happens";
    TimerMgr::start(&one.manager, 0);
    EXPECT_EQ(countOf(one.timer), "9") << "a literal 0 is an id";
    stated(&one.manager, 3);
    TimerMgr::stop(&one.manager, 3);
    EXPECT_EQ(countOf(one.timer), "10");
}

TEST(TimerMgr, is_found_by_name_the_first_made_first) {
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

TEST(TimerMgr, finds_timers_that_another_thread_creates_in_reserved_slots) {
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

TEST(TimerMgr, serves_many_threads) {
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
