#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "basis/platform/xos_url.h"
#include "host/include/xos_host.h"
#include "tests/host/xos_basics/control/recorded_calls.h"
#include "tests/support/fallible_calls.h"

#include <gtest/gtest.h>

namespace {

constexpr char const* const CANNOT_FAIL[] = {"xos_MsCount",         "xos_StrCmp",   "xos_TaskSleep",  "xos_Assert",
                                             "xos_DirForceCaseAny", "xos_DirClose", "cfg_GroupDelete"};

struct HostFunctions : RecordedCalls {};

TEST_F(HostFunctions, refuses_to_fail_what_cannot_fail_or_does_not_exist) {
    for (char const* const name : CANNOT_FAIL) { EXPECT_EQ(xos_HostFail(name, 0, 1), -1) << name; }
    for (char const* const name : {"", "xos_FileMov", "xos_FileMoveEx", "New", "AlertTimer::New", "xos_HostFail"}) {
        EXPECT_EQ(xos_HostFail(name, 0, 1), -1) << name;
    }
    EXPECT_EQ(xos_HostFail(nullptr, 0, 1), -1);
}

TEST_F(HostFunctions, accepts_every_function_that_can_fail) {
    for (char const* const name : FALLIBLE_CALLS) { EXPECT_EQ(xos_HostFail(name, 3, 1), 0) << name; }
}

} // namespace
