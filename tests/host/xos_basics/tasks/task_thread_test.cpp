#include "basis/platform/xos_basics.h"
#include "tests/host/xos_basics/tasks/started_tasks.h"
#include "tests/support/thread_facts.h"
#include "tests/support/wait_for.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstddef>
#include <cstring>
#include <string>

namespace {

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

TEST(HostTaskThread, names_its_thread) {
    std::string const longName = "a task with a name that no thread can have in full, however long";
    for (std::string const& name : {std::string{"MTQ_Dat::start"}, std::string{"x"}, longName, std::string{"y"}}) {
        EXPECT_EQ(nameInTask(name.c_str()), name.substr(0, LONGEST_THREAD_NAME));
    }
    EXPECT_EQ(nameInTask(nullptr), "xos_task") << "not the name of the task before it";
}

TEST(HostTaskThread, has_the_stack_that_it_asks_for) {
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

} // namespace
