#include "host/xos_basics/thread_end.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

namespace {

std::atomic<int> ends{0};

void addToEnds(void* value) { ends += *static_cast<int*>(value); }

TEST(HostThreadEnd, calls_once_for_each_thread_that_set_a_value) {
    static host::ThreadEnd const end{addToEnds};
    int one = 1;
    int ten = 10;
    int hundred = 100;
    ends = 0;
    std::thread([] {}).join();
    EXPECT_EQ(ends, 0) << "a thread without a value";
    std::thread([&] { end.set(&one); }).join();
    EXPECT_EQ(ends, 1);
    std::thread([&] {
        end.set(&hundred);
        end.set(&ten);
        EXPECT_EQ(ends, 1) << "before the end";
    }).join();
    EXPECT_EQ(ends, 11) << "only the value set last counts";
}

TEST(HostThreadEnd, calls_of_two_users_do_not_mix) {
    static std::atomic<int> others{0};
    static host::ThreadEnd const end{addToEnds};
    static host::ThreadEnd const other{[](void* value) { others += *static_cast<int*>(value); }};
    int one = 1;
    int ten = 10;
    ends = 0;
    std::thread([&] {
        end.set(&one);
        other.set(&ten);
    }).join();
    EXPECT_EQ(ends, 1);
    EXPECT_EQ(others, 10);
}

} // namespace
