#include "basis/platform/xos_basics.h"
#include "tests/host/xos_basics/tasks/started_tasks.h"
#include "tests/support/wait_for.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <thread>

namespace {

using namespace std::chrono_literals;

class HeldMutex {
public:
    HeldMutex() { xos_SemTake(mutex_); }
    HeldMutex(HeldMutex const&) = delete;
    HeldMutex& operator=(HeldMutex const&) = delete;
    ~HeldMutex() {
        give();
        xos_SemDestroy(mutex_);
    }
    void give() { xos_SemGive(mutex_); }

private:
    xos_Sem const mutex_{xos_SemMCreate()};
};

/// Tasks that all have to run at the same time before the first of them ends.
struct Meeting {
    static constexpr int SIZE = 40;
    std::atomic<int> present{0};
    std::atomic<int> gone{0};
    std::atomic<bool> mayLeave{false};

    void call() {
        for (int i = 0; i < SIZE; ++i) { EXPECT_NE(start(attend, this), NO_TASK); }
    }
    bool isComplete() const { return present == SIZE; }
    bool end() {
        mayLeave = true;
        return waitFor([this] { return gone == SIZE; });
    }
    static void attend(void* meeting) {
        auto& self = *static_cast<Meeting*>(meeting);
        ++self.present;
        while (!self.mayLeave) { std::this_thread::sleep_for(100us); }
        ++self.gone;
    }
};

TEST(HostDeferredTask, runs_although_its_creator_keeps_a_mutex) {
    HeldMutex const held;
    Meeting meeting;
    meeting.call();
    EXPECT_TRUE(waitFor([&] { return meeting.isComplete(); })) << "no platform call of the creator helps";
    EXPECT_TRUE(meeting.end());
}

TEST(HostDeferredTask, runs_when_its_creator_gives_its_last_mutex) {
    for (int round = 0; round < 20; ++round) {
        HeldMutex outer;
        HeldMutex inner;
        Meeting meeting;
        meeting.call();
        inner.give();
        outer.give();
        EXPECT_TRUE(waitFor([&] { return meeting.isComplete(); }));
        EXPECT_TRUE(meeting.end());
    }
}

TEST(HostDeferredTask, runs_when_its_creator_waits_for_it_with_a_mutex_in_its_hands) {
    struct Signal {
        xos_Sem semaphore = xos_SemBCreate(0);
        static void give(void* signal) { xos_SemGive(static_cast<Signal*>(signal)->semaphore); }
    } signal;
    HeldMutex const held;
    for (int round = 0; round < 200; ++round) {
        EXPECT_NE(start(Signal::give, &signal), NO_TASK);
        EXPECT_EQ(xos_SemTake(signal.semaphore), 0);
    }
    xos_SemDestroy(signal.semaphore);
}

TEST(HostDeferredTask, runs_after_its_creator_destroyed_the_mutex_that_it_held) {
    xos_Sem const mutex = xos_SemMCreate();
    xos_SemTake(mutex);
    Meeting first;
    first.call();
    xos_SemDestroy(mutex);
    Meeting second;
    second.call();
    EXPECT_TRUE(waitFor([&] { return first.isComplete() && second.isComplete(); }));
    EXPECT_TRUE(first.end() && second.end());
}

TEST(HostDeferredTask, runs_although_its_creator_ends_with_a_mutex_in_its_hands) {
    xos_Sem const mutex = xos_SemMCreate();
    Meeting meeting;
    std::thread([&] {
        xos_SemTake(mutex);
        meeting.call();
    }).join();
    EXPECT_TRUE(waitFor([&] { return meeting.isComplete(); }));
    EXPECT_TRUE(meeting.end());
    xos_SemDestroy(mutex);
}

} // namespace
