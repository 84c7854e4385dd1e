#include "basis/platform/hq_basis.h"
#include "host/include/xos_host.h"
#include "tests/support/wait_for.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <set>
#include <thread>
#include <vector>

namespace {

using namespace std::chrono_literals;
using HQ_Basis::AlertTimer;

constexpr std::uint32_t A_MINUTE = 60'000;

struct Seen {
    std::atomic<int> times{0};
    std::atomic<std::uint32_t> id{0};
    std::atomic<std::uint32_t> nextPeriod{A_MINUTE};
    std::atomic<bool> isInside{false};
    std::atomic<bool> mayLeave{true};
    std::atomic<std::thread::id> thread;
};

std::uint32_t see(AlertTimer::Alert const& alert) {
    auto& seen = *static_cast<Seen*>(alert.context);
    seen.isInside = true;
    seen.id = alert.id;
    seen.thread = std::this_thread::get_id();
    ++seen.times;
    while (!seen.mayLeave) { std::this_thread::sleep_for(100us); }
    seen.isInside = false;
    return seen.nextPeriod;
}

TEST(HostAlert, runs_after_its_period_with_its_record_on_another_thread) {
    Seen seen;
    auto const start = std::chrono::steady_clock::now();
    std::uint32_t const id = AlertTimer::New(20, see, &seen);
    ASSERT_NE(id, 0u);
    ASSERT_TRUE(waitFor([&] { return seen.times == 1; }));
    EXPECT_GE(std::chrono::steady_clock::now() - start, 19ms);
    EXPECT_EQ(seen.id, id);
    EXPECT_NE(seen.thread.load(), std::this_thread::get_id());
    AlertTimer::Delete(id);
}

TEST(HostAlert, takes_the_returned_value_for_its_next_period) {
    Seen seen;
    seen.nextPeriod = 1;
    std::uint32_t const id = AlertTimer::New(1, see, &seen);
    EXPECT_TRUE(waitFor([&] { return seen.times >= 5; }));
    seen.nextPeriod = A_MINUTE;
    std::this_thread::sleep_for(30ms);
    int const times = seen.times;
    std::this_thread::sleep_for(50ms);
    EXPECT_LE(seen.times, times + 1);
    AlertTimer::Delete(id);
}

TEST(HostAlert, runs_no_more_once_it_is_deleted) {
    Seen seen;
    seen.nextPeriod = 1;
    std::uint32_t const id = AlertTimer::New(1, see, &seen);
    EXPECT_TRUE(waitFor([&] { return seen.times >= 2; }));
    AlertTimer::Delete(id);
    int const times = seen.times;
    std::this_thread::sleep_for(40ms);
    EXPECT_EQ(seen.times, times);
    AlertTimer::Delete(id);
    AlertTimer::Delete(0);
}

TEST(HostAlert, may_be_deleted_before_it_ever_ran) {
    Seen seen;
    AlertTimer::Delete(AlertTimer::New(20, see, &seen));
    std::this_thread::sleep_for(60ms);
    EXPECT_EQ(seen.times, 0);
}

TEST(HostAlert, has_returned_when_deleting_it_from_elsewhere_returns) {
    for (int i = 0; i < 20; ++i) {
        Seen seen;
        seen.mayLeave = false;
        std::uint32_t const id = AlertTimer::New(1, see, &seen);
        EXPECT_TRUE(waitFor([&] { return seen.isInside.load(); }));
        std::thread release([&] {
            std::this_thread::sleep_for(3ms);
            seen.mayLeave = true;
        });
        AlertTimer::Delete(id);
        EXPECT_FALSE(seen.isInside);
        release.join();
    }
}

TEST(HostAlert, may_be_deleted_from_inside_its_callback) {
    struct Self {
        std::atomic<int> times{0};
    };
    auto* const self = new Self;
    static std::atomic<bool> isDeleted{false};
    auto* const callback = +[](AlertTimer::Alert const& alert) -> std::uint32_t {
        auto* const own = static_cast<Self*>(alert.context);
        ++own->times;
        AlertTimer::Delete(alert.id);
        // Nobody runs it again, so that what it works on may go.
        delete own;
        isDeleted = true;
        return 1;
    };
    AlertTimer::New(1, callback, self);
    EXPECT_TRUE(waitFor([&] { return isDeleted.load(); }));
    std::this_thread::sleep_for(30ms);
}

TEST(HostAlert, that_never_returns_delays_no_other_and_not_its_deletion) {
    // Of static life, as one callback stays inside.
    static Seen stuck;
    stuck.mayLeave = false;
    std::uint32_t const stuckId = AlertTimer::New(1, see, &stuck);
    ASSERT_TRUE(waitFor([&] { return stuck.isInside.load(); }));
    std::vector<Seen> others(10);
    std::vector<std::uint32_t> ids;
    for (Seen& seen : others) {
        seen.nextPeriod = 1;
        ids.push_back(AlertTimer::New(1, see, &seen));
    }
    for (Seen const& seen : others) {
        EXPECT_TRUE(waitFor([&] { return seen.times >= 3; }));
    }
    for (std::uint32_t const id : ids) { AlertTimer::Delete(id); }
    auto const start = std::chrono::steady_clock::now();
    AlertTimer::Delete(stuckId);
    EXPECT_LT(std::chrono::steady_clock::now() - start, 10s);
    stuck.mayLeave = true;
    EXPECT_TRUE(waitFor([&] { return !stuck.isInside; }));
    std::this_thread::sleep_for(20ms);
    EXPECT_EQ(stuck.times, 1);
}

TEST(HostAlert, does_not_run_twice_at_a_time) {
    Seen seen;
    seen.mayLeave = false;
    seen.nextPeriod = 1;
    std::uint32_t const id = AlertTimer::New(1, see, &seen);
    EXPECT_TRUE(waitFor([&] { return seen.isInside.load(); }));
    std::this_thread::sleep_for(30ms);
    EXPECT_EQ(seen.times, 1);
    seen.mayLeave = true;
    AlertTimer::Delete(id);
}

TEST(HostAlert, keeps_many_apart) {
    constexpr std::size_t COUNT = 200;
    std::vector<Seen> all(COUNT);
    std::set<std::uint32_t> ids;
    for (Seen& seen : all) { ids.insert(AlertTimer::New(5, see, &seen)); }
    EXPECT_EQ(ids.size(), COUNT);
    for (Seen const& seen : all) {
        EXPECT_TRUE(waitFor([&] { return seen.times == 1; }));
    }
    for (std::uint32_t const id : ids) { AlertTimer::Delete(id); }
    std::set<std::uint32_t> seenIds;
    for (Seen const& seen : all) { seenIds.insert(seen.id); }
    EXPECT_EQ(seenIds, ids);
}

TEST(HostAlert, comes_in_the_order_of_the_periods) {
    static std::atomic<int> order{0};
    struct Place {
        std::atomic<int> place{0};
    };
    Place late;
    Place early;
    auto* const callback = +[](AlertTimer::Alert const& alert) -> std::uint32_t {
        static_cast<Place*>(alert.context)->place = ++order;
        return A_MINUTE;
    };
    std::uint32_t const lateId = AlertTimer::New(120, callback, &late);
    std::uint32_t const earlyId = AlertTimer::New(10, callback, &early);
    EXPECT_TRUE(waitFor([&] { return order == 2; }));
    EXPECT_EQ(early.place, 1);
    EXPECT_EQ(late.place, 2);
    AlertTimer::Delete(lateId);
    AlertTimer::Delete(earlyId);
}

TEST(HostAlert, is_not_made_without_a_callback) { EXPECT_EQ(AlertTimer::New(1, nullptr, nullptr), 0u); }

TEST(HostAlertFire, runs_the_callback_now_on_the_calling_thread) {
    Seen seen;
    std::uint32_t const id = AlertTimer::New(A_MINUTE, see, &seen);
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(seen.times, 2);
    EXPECT_EQ(seen.id, id);
    EXPECT_EQ(seen.thread.load(), std::this_thread::get_id());
    AlertTimer::Delete(id);
}

TEST(HostAlertFire, knows_only_alerts_that_exist) {
    Seen seen;
    std::uint32_t const id = AlertTimer::New(A_MINUTE, see, &seen);
    AlertTimer::Delete(id);
    EXPECT_EQ(xos_HostAlertFire(id), -1);
    EXPECT_EQ(xos_HostAlertFire(0), -1);
    EXPECT_EQ(seen.times, 0);
}

TEST(HostAlertFire, starts_the_next_period_anew) {
    Seen seen;
    seen.nextPeriod = 10;
    std::uint32_t const id = AlertTimer::New(A_MINUTE, see, &seen);
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_TRUE(waitFor([&] { return seen.times >= 2; })) << "by itself";
    AlertTimer::Delete(id);
}

TEST(HostAlertFire, waits_for_a_callback_that_runs_elsewhere) {
    Seen seen;
    seen.mayLeave = false;
    std::uint32_t const id = AlertTimer::New(1, see, &seen);
    EXPECT_TRUE(waitFor([&] { return seen.isInside.load(); }));
    std::thread release([&] {
        std::this_thread::sleep_for(20ms);
        seen.mayLeave = true;
    });
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(seen.times, 2);
    release.join();
    AlertTimer::Delete(id);
}

TEST(HostAlertFire, lets_a_callback_delete_its_alert_and_refuses_to_nest) {
    static std::atomic<int> nested{0};
    auto* const callback = +[](AlertTimer::Alert const& alert) -> std::uint32_t {
        nested = xos_HostAlertFire(alert.id);
        AlertTimer::Delete(alert.id);
        return 1;
    };
    std::uint32_t const id = AlertTimer::New(A_MINUTE, callback, nullptr);
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(nested, -1);
    EXPECT_EQ(xos_HostAlertFire(id), -1);
}

TEST(HostAlertFaults, leave_an_alert_that_is_not_deleted_and_make_none) {
    Seen seen;
    std::uint32_t const id = AlertTimer::New(A_MINUTE, see, &seen);
    ASSERT_EQ(xos_HostFail("HQ_Basis::AlertTimer::Delete", 0, 1), 0);
    AlertTimer::Delete(id);
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    AlertTimer::Delete(id);
    EXPECT_EQ(xos_HostAlertFire(id), -1);
    ASSERT_EQ(xos_HostFail("HQ_Basis::AlertTimer::New", 0, 1), 0);
    EXPECT_EQ(AlertTimer::New(1, see, &seen), 0u);
    std::this_thread::sleep_for(20ms);
    EXPECT_EQ(seen.times, 1);
}

} // namespace
