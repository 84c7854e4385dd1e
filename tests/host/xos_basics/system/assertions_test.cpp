#include "basis/platform/xos_basics.h"
#include "host/include/xos_host.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>

namespace {

struct Heard {
    int line{0};
    std::string module;
    std::string message;
    int times{0};
};

void hear(int line, char const* module, char const* message, void* context) {
    auto& heard = *static_cast<Heard*>(context);
    heard = {line, module, message, heard.times + 1};
}

TEST(HostAssert, writes_module_line_and_message_and_returns) {
    testing::internal::CaptureStderr();
    xos_Assert(356, "zor_basis", "TimerMgr::add() - already registered!");
    xos_Assert(-1, nullptr, nullptr);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "zor_basis:356: TimerMgr::add() - already registered!\n:-1: \n");
}

TEST(HostAssert, tells_a_handler_instead) {
    Heard heard;
    xos_HostSetAssertHandler(hear, &heard);
    testing::internal::CaptureStderr();
    xos_Assert(100, "module", "message");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "");
    EXPECT_EQ(heard.line, 100);
    EXPECT_EQ(heard.module, "module");
    EXPECT_EQ(heard.message, "message");
    xos_HostSetAssertHandler(nullptr, nullptr);
    testing::internal::CaptureStderr();
    xos_Assert(1, "m", "back");
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "m:1: back\n");
    EXPECT_EQ(heard.times, 1);
}

TEST(HostAssert, lets_a_handler_assert_and_take_itself_away) {
    static Heard heard;
    auto* const handler = +[](int line, char const* module, char const* message, void*) {
        xos_HostSetAssertHandler(hear, &heard);
        xos_Assert(line + 1, module, message);
    };
    xos_HostSetAssertHandler(handler, nullptr);
    xos_Assert(1, "m", "nested");
    EXPECT_EQ(heard.line, 2);
    xos_HostSetAssertHandler(nullptr, nullptr);
}

} // namespace
