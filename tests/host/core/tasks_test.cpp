#include "basis/platform/xos_basics.h"
#include "host/include/xos_host.h"
#include "tests/host/core/thread_facts.h"
#include "tests/host/support/child.h"
#include "tests/host/support/system_error.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <mutex>
#include <set>
#include <string>
#include <thread>
#include <vector>

namespace {

using namespace std::chrono_literals;

constexpr xos_Task NO_TASK = ~xos_Task{0};

bool waitFor(std::function<bool()> const& condition) {
    auto const end = std::chrono::steady_clock::now() + 30s;
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::sleep_for(100us);
    }
    return true;
}

xos_Task start(void (*entry)(void*), void* argument, char const* name = "test", std::uint64_t stackSize = 0) {
    xos_TaskParams const params{entry, argument, 0, -9, stackSize, name, 0};
    return xos_TaskCreate(&params);
}

void count(void* counter) { ++*static_cast<std::atomic<int>*>(counter); }

TEST(HostTask, runs_its_entry_with_its_argument) {
    std::atomic<int> counter{0};
    xos_Task const task = start(count, &counter);
    EXPECT_NE(task, NO_TASK);
    EXPECT_NE(task, 0u);
    EXPECT_TRUE(waitFor([&] { return counter == 1; }));
}

TEST(HostTask, has_a_handle_of_its_own) {
    constexpr std::size_t COUNT = 100;
    std::atomic<int> counter{0};
    std::set<xos_Task> handles;
    for (std::size_t i = 0; i < COUNT; ++i) { handles.insert(start(count, &counter)); }
    EXPECT_EQ(handles.size(), COUNT);
    EXPECT_TRUE(waitFor([&] { return counter == int{COUNT}; }));
}

TEST(HostTask, gives_all_ones_without_parameters_without_entry_and_without_a_thread) {
    clearSystemError();
    EXPECT_EQ(xos_TaskCreate(nullptr), NO_TASK);
    EXPECT_NE(systemError(), 0);
    std::atomic<int> counter{0};
    EXPECT_EQ(start(nullptr, &counter), NO_TASK);
    clearSystemError();
    EXPECT_EQ(start(count, &counter, "huge", std::uint64_t{1} << 62), NO_TASK) << "no such stack can be had";
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(counter, 0);
}

TEST(HostTask, runs_on_another_thread_and_alone_there) {
    constexpr int COUNT = 40;
    struct Shared {
        std::mutex mutex;
        std::set<std::thread::id> threads;
        std::atomic<bool> go{false};
        std::atomic<int> done{0};
    } shared;
    for (int i = 0; i < COUNT; ++i) {
        auto* const entry = +[](void* argument) {
            auto& all = *static_cast<Shared*>(argument);
            {
                std::lock_guard const lock{all.mutex};
                all.threads.insert(std::this_thread::get_id());
            }
            while (!all.go) { std::this_thread::sleep_for(100us); }
            ++all.done;
        };
        ASSERT_NE(start(entry, &shared), NO_TASK);
    }
    auto const threads = [&] {
        std::lock_guard const lock{shared.mutex};
        return shared.threads.size();
    };
    EXPECT_TRUE(waitFor([&] { return threads() == COUNT; })) << "none waits for another's end";
    EXPECT_EQ(shared.threads.count(std::this_thread::get_id()), 0u);
    shared.go = true;
    EXPECT_TRUE(waitFor([&] { return shared.done == COUNT; }));
}

TEST(HostTask, never_waits_for_the_end_of_the_one_before_it) {
    // Each one ends only when the next has begun.
    constexpr int LENGTH = 200;
    struct Link {
        Link* links;
        int index;
        std::atomic<bool> hasBegun{false};
        std::atomic<bool> hasEnded{false};
    };
    std::vector<Link> links(LENGTH + 1);
    for (int i = 0; i <= LENGTH; ++i) {
        links[static_cast<std::size_t>(i)].links = links.data();
        links[static_cast<std::size_t>(i)].index = i;
    }
    auto* const entry = +[](void* argument) {
        auto& link = *static_cast<Link*>(argument);
        link.hasBegun = true;
        while (!link.links[link.index + 1].hasBegun) { std::this_thread::yield(); }
        link.hasEnded = true;
    };
    for (int i = 0; i < LENGTH; ++i) { ASSERT_NE(start(entry, &links[static_cast<std::size_t>(i)]), NO_TASK); }
    links[LENGTH].hasBegun = true;
    EXPECT_TRUE(waitFor([&] {
        for (int i = 0; i < LENGTH; ++i) {
            if (!links[static_cast<std::size_t>(i)].hasEnded) return false;
        }
        return true;
    }));
}

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

TEST(HostTask, runs_although_its_creator_keeps_a_mutex) {
    HeldMutex const held;
    Meeting meeting;
    meeting.call();
    EXPECT_TRUE(waitFor([&] { return meeting.isComplete(); })) << "no platform call of the creator helps";
    EXPECT_TRUE(meeting.end());
}

TEST(HostTask, runs_when_its_creator_gives_its_last_mutex) {
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

TEST(HostTask, runs_when_its_creator_waits_for_it_with_a_mutex_in_its_hands) {
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

TEST(HostTask, runs_after_its_creator_destroyed_the_mutex_that_it_held) {
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

TEST(HostTask, runs_although_its_creator_ends_with_a_mutex_in_its_hands) {
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

TEST(HostTask, uses_threads_again) {
    constexpr int COUNT = 500;
    struct Shared {
        std::mutex mutex;
        std::set<std::thread::id> threads;
        std::atomic<int> done{0};
    } shared;
    for (int i = 1; i <= COUNT; ++i) {
        auto* const entry = +[](void* argument) {
            auto& all = *static_cast<Shared*>(argument);
            {
                std::lock_guard const lock{all.mutex};
                all.threads.insert(std::this_thread::get_id());
            }
            ++all.done;
        };
        start(entry, &shared);
        ASSERT_TRUE(waitFor([&] { return shared.done == i; }));
    }
    EXPECT_LT(shared.threads.size(), 100u);
}

TEST(HostTask, loses_none_of_many_made_by_many_threads) {
    constexpr int MAKERS = 4;
    constexpr int COUNT = 2'000;
    std::atomic<int> counter{0};
    std::vector<std::thread> makers;
    for (int i = 0; i < MAKERS; ++i) {
        makers.emplace_back([&counter] {
            for (int j = 0; j < COUNT; ++j) { EXPECT_NE(start(count, &counter), NO_TASK); }
        });
    }
    for (std::thread& maker : makers) { maker.join(); }
    EXPECT_TRUE(waitFor([&] { return counter == MAKERS * COUNT; }));
}

TEST(HostTask, may_make_tasks) {
    struct Tree {
        std::atomic<int> left{100};
        std::atomic<int> done{0};
    } tree;
    static auto* const grow = +[](void* argument) {
        auto& all = *static_cast<Tree*>(argument);
        // Two more each, as long as there are any left.
        for (int i = 0; i < 2; ++i) {
            if (all.left-- > 0) {
                xos_TaskParams params{};
                params.entry = [](void* next) { ++static_cast<Tree*>(next)->done; };
                params.argument = argument;
                xos_TaskCreate(&params);
            }
        }
        ++all.done;
    };
    for (int i = 0; i < 50; ++i) { start(grow, &tree); }
    EXPECT_TRUE(waitFor([&] { return tree.done == 150; }));
}

struct NameProbe {
    std::string name;
    std::atomic<bool> isDone{false};
};

std::string nameInTask(char const* name) {
    NameProbe probe;
    auto* const entry = +[](void* argument) {
        auto& asked = *static_cast<NameProbe*>(argument);
        asked.name = nameOfThisThread();
        asked.isDone = true;
    };
    start(entry, &probe, name);
    waitFor([&] { return probe.isDone.load(); });
    return probe.name;
}

TEST(HostTask, names_its_thread) {
    std::string const longName = "a task with a name that no thread can have in full, however long";
    for (std::string const& name : {std::string{"MTQ_Dat::start"}, std::string{"x"}, longName, std::string{"y"}}) {
        EXPECT_EQ(nameInTask(name.c_str()), name.substr(0, LONGEST_THREAD_NAME));
    }
    EXPECT_EQ(nameInTask(nullptr), "xos_task") << "not the name of the task before it";
}

TEST(HostTask, has_the_stack_that_it_asks_for) {
    constexpr std::size_t ASKED = 64 * 1024 * 1024;
    std::atomic<int> counter{0};
    auto* const entry = +[](void* argument) {
        // Touches half of it, which the usual stack does not have.
        static constexpr std::size_t PAGE = 4096;
        struct Deep {
            static int go(std::size_t left) {
                char volatile page[PAGE];
                page[0] = 1;
                int const rest = left > PAGE ? go(left - PAGE) : 0;
                return rest + page[0];
            }
        };
        *static_cast<std::atomic<int>*>(argument) = Deep::go(ASKED / 2);
    };
    ASSERT_NE(start(entry, &counter, "deep", ASKED), NO_TASK);
    EXPECT_TRUE(waitFor([&] { return counter == int{ASKED / 2 / 4096}; }));
}

TEST(HostTask, that_never_returns_does_not_keep_the_process) {
    Child child{programBeside("host_child"), {"stuck"}};
    EXPECT_EQ(child.wait(), 7);
}

TEST(HostTime, sleeps_at_least_as_long_as_asked) {
    for (std::uint32_t const ms : {0U, 1U, 20U, 60U}) {
        auto const start = std::chrono::steady_clock::now();
        xos_TaskSleep(ms);
        auto const slept = std::chrono::steady_clock::now() - start;
        EXPECT_GE(slept, std::chrono::milliseconds{ms} - 1ms);
        EXPECT_LT(slept, std::chrono::milliseconds{ms} + 5s);
    }
}

TEST(HostTime, counts_milliseconds) {
    std::uint32_t const start = xos_MsCount();
    std::this_thread::sleep_for(50ms);
    std::uint32_t const passed = xos_MsCount() - start;
    EXPECT_GE(passed, 49u);
    EXPECT_LT(passed, 5'000u);
}

} // namespace
