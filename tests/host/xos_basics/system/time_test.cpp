#include "basis/platform/xos_basics.h"

#include <gtest/gtest.h>

#include <chrono>
#include <cstdint>
#include <thread>

namespace {

using namespace std::chrono_literals;

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
