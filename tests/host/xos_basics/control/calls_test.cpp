#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "basis/platform/xos_url.h"
#include "host/include/xos_host.h"
#include "tests/host/xos_basics/control/recorded_calls.h"

#include <gtest/gtest.h>

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <thread>
#include <vector>

namespace {

struct HostCalls : RecordedCalls {};

TEST_F(HostCalls, counts_calls_that_fail_and_calls_with_bad_arguments) {
    xos_HostFail("xos_SemTake", 0, 1);
    xos_SemTake(0);
    xos_SemTake(0);
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 0u);
    EXPECT_EQ(xos_HostCalls("no such function"), 0u);
    EXPECT_EQ(xos_HostCalls(nullptr), 0u);
}

TEST_F(HostCalls, forgets_counts_and_last_calls_at_a_reset) {
    xos_StrCmp("a", "b");
    EXPECT_EQ(xos_HostCalls("xos_StrCmp"), 1u);
    EXPECT_EQ(lastCall("xos_StrCmp"), "\"a\", \"b\"");
    xos_HostCallsReset();
    EXPECT_EQ(xos_HostCalls("xos_StrCmp"), 0u);
    EXPECT_EQ(xos_HostLastCall("xos_StrCmp"), nullptr);
    xos_StrCmp("c", "d");
    EXPECT_EQ(xos_HostCalls("xos_StrCmp"), 1u);
    EXPECT_EQ(lastCall("xos_StrCmp"), "\"c\", \"d\"");
}

TEST_F(HostCalls, has_no_last_call_of_what_was_not_called_or_does_not_exist) {
    EXPECT_EQ(xos_HostLastCall("xos_SemMCreate"), nullptr);
    EXPECT_EQ(xos_HostLastCall("no such function"), nullptr);
    EXPECT_EQ(xos_HostLastCall(nullptr), nullptr);
}

TEST_F(HostCalls, writes_last_calls_as_documented) {
    std::uint32_t word = 0;
    xos_SemDestroy(xos_SemMCreate());
    EXPECT_EQ(lastCall("xos_SemMCreate"), "");

    xos_SemBCreate(-3);
    EXPECT_EQ(lastCall("xos_SemBCreate"), "-3");

    xos_SemNamedMutexCreate(-264, 0x1F, -1, &word);
    EXPECT_EQ(lastCall("xos_SemNamedMutexCreate"),
              "-264, 0x1f, -1, " + hexadecimal(reinterpret_cast<std::uintptr_t>(&word)));
    xos_SemNamedMutexCreate(264, 0, 0, nullptr);
    EXPECT_EQ(lastCall("xos_SemNamedMutexCreate"), "264, 0x0, 0, null");

    xos_SemTake(0);
    EXPECT_EQ(lastCall("xos_SemTake"), "0x0");

    xos_TaskSleep(0);
    EXPECT_EQ(lastCall("xos_TaskSleep"), "0");

    xos_StrCmp("a\"b\\", nullptr);
    EXPECT_EQ(lastCall("xos_StrCmp"), "\"a\"b\\\", null");
    xos_StrCmp("", nullptr);
    EXPECT_EQ(lastCall("xos_StrCmp"), "\"\", null");

    xos_BasicsParamLookup(0xFFFF8006, nullptr, 8);
    EXPECT_EQ(lastCall("xos_BasicsParamLookup"), "0xffff8006, null, 8");

    xos_LibraryLoad(nullptr);
    EXPECT_EQ(lastCall("xos_LibraryLoad"), "null");

    cfg_GroupLoadFromFile("no-such-group", 1, -2, 3);
    EXPECT_EQ(lastCall("cfg_GroupLoadFromFile"), "\"no-such-group\", 1, -2, 3");

    EXPECT_EQ(cfg_KeyGetOpt_Bool(nullptr, "key", 5), 5);
    EXPECT_EQ(lastCall("cfg_KeyGetOpt_Bool"), "null, \"key\", 5");

    xos_URLGet("gopher://x", "target", nullptr, "secret");
    EXPECT_EQ(lastCall("xos_URLGet"), "\"gopher://x\", \"target\", null, \"secret\"");

    HQ_Basis::AlertTimer::New(8192, nullptr, &word);
    EXPECT_EQ(lastCall("HQ_Basis::AlertTimer::New"),
              "8192, null, " + hexadecimal(reinterpret_cast<std::uintptr_t>(&word)));
    HQ_Basis::AlertTimer::Delete(4'000'000'000);
    EXPECT_EQ(lastCall("HQ_Basis::AlertTimer::Delete"), "4000000000");
}

TEST_F(HostCalls, gives_the_seven_fields_of_a_task) {
    xos_TaskParams params{doNothing, nullptr, 0, -9, 0, "MTQ_Dat::start", 0};
    xos_TaskCreate(&params);
    EXPECT_EQ(lastCall("xos_TaskCreate"),
              hexadecimal(reinterpret_cast<std::uintptr_t>(doNothing)) + ", null, 0x0, -9, 0, \"MTQ_Dat::start\", 0");
    xos_TaskCreate(nullptr);
    EXPECT_EQ(lastCall("xos_TaskCreate"), "null, null, 0x0, 0, 0, null, 0");
}

TEST_F(HostCalls, copies_texts_of_any_length) {
    for (std::size_t const length : {0, 1, 7, 8, 9, 255, 256, 4096, 100'000, 5}) {
        SCOPED_TRACE(length);
        std::string first(length, 'a');
        std::string second(length / 2, 'b');
        xos_StrCmp(first.c_str(), second.c_str());
        first.assign(length, 'x');
        second.assign(length / 2, 'y');
        EXPECT_EQ(lastCall("xos_StrCmp"),
                  '"' + std::string(length, 'a') + "\", \"" + std::string(length / 2, 'b') + '"');
    }
}

TEST_F(HostCalls, counts_the_calls_of_all_threads_living_or_not) {
    constexpr int THREADS = 8;
    constexpr int CALLS = 2'000;
    for (int round = 1; round <= 3; ++round) {
        std::vector<std::thread> threads;
        for (int i = 0; i < THREADS; ++i) {
            threads.emplace_back([] {
                for (int j = 0; j < CALLS; ++j) { xos_MsCount(); }
            });
        }
        for (std::thread& thread : threads) { thread.join(); }
        EXPECT_EQ(xos_HostCalls("xos_MsCount"), static_cast<std::uint64_t>(round) * THREADS * CALLS);
    }
}

TEST_F(HostCalls, keeps_the_text_of_a_last_call_until_the_threads_next_question) {
    xos_StrCmp("a", "b");
    char const* const text = xos_HostLastCall("xos_StrCmp");
    std::thread([] {
        xos_StrCmp("c", "d");
        xos_HostLastCall("xos_StrCmp");
    }).join();
    EXPECT_STREQ(text, "\"a\", \"b\"");
}

} // namespace
