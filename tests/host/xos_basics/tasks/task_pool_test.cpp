#include "basis/platform/xos_basics.h"
#include "tests/host/xos_basics/tasks/started_tasks.h"
#include "tests/support/wait_for.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstddef>
#include <mutex>
#include <set>
#include <thread>
#include <vector>

namespace {

TEST(HostTaskPool, never_waits_for_the_end_of_the_one_before_it) {
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

TEST(HostTaskPool, uses_threads_again) {
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

TEST(HostTaskPool, loses_none_of_many_made_by_many_threads) {
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

TEST(HostTaskPool, may_make_tasks) {
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

} // namespace
