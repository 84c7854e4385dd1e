#include "basis/platform/xos_basics.h"
#include "tests/host/support/child.h"
#include "tests/host/xos_basics/tasks/started_tasks.h"
#include "tests/support/system_error.h"
#include "tests/support/wait_for.h"

#include <gtest/gtest.h>

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <mutex>
#include <set>
#include <thread>

namespace {

using namespace std::chrono_literals;

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

TEST(HostTask, that_never_returns_does_not_keep_the_process) {
    Child child{programBeside("host_child"), {"stuck"}};
    EXPECT_EQ(child.wait(), 7);
}

} // namespace
