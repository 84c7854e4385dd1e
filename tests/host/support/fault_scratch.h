/// \file
/// A folder in which platform functions fail on demand.

#ifndef TESTS_HOST_SUPPORT_FAULT_SCRATCH_H
#define TESTS_HOST_SUPPORT_FAULT_SCRATCH_H

#include "tests/support/scratch.h"
#include "tests/support/system_error.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <functional>

struct FaultScratch : testing::Test {
    ~FaultScratch() override { xos_HostFailClear(); }

    /// Checks that the call fails once as injected, without effect, and that the next one is good.
    void failsOnce(char const* function, std::function<bool()> const& succeeds) {
        SCOPED_TRACE(function);
        Names const before = scratch.content();
        ASSERT_EQ(xos_HostFail(function, 0, 1), 0);
        std::uint64_t const calls = xos_HostCalls(function);
        clearSystemError();
        EXPECT_FALSE(succeeds());
        EXPECT_EQ(systemError(), INJECTED_ERROR);
        EXPECT_EQ(scratch.content(), before);
        EXPECT_EQ(xos_HostCalls(function), calls + 1);
        EXPECT_TRUE(succeeds());
    }

    Scratch scratch;
};

#endif
