#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "basis/platform/xos_url.h"
#include "host/include/xos_host.h"
#include "tests/host/support/child.h"
#include "tests/host/xos_basics/control/recorded_calls.h"
#include "tests/support/scratch.h"
#include "tests/support/system_error.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstdint>
#include <cstring>
#include <functional>
#include <string>
#include <thread>
#include <vector>

namespace {

std::uint32_t onceAMinute(HQ_Basis::AlertTimer::Alert const&) { return 60'000; }

struct HostFaults : RecordedCalls {};

TEST_F(HostFaults, fails_after_the_skipped_calls_and_so_many_times) {
    struct Case {
        Row row;
        std::uint32_t skip;
        std::uint32_t times;
        char const* expected;
    };
    for (Case const& c : {Case{{}, 0, 0, "++++++"}, Case{{}, 0, 1, "-+++++"}, Case{{}, 2, 1, "++-+++"},
                          Case{{}, 1, 3, "+---++"}, Case{{}, 0, 0xFFFFFFFF, "------"}, Case{{}, 6, 1, "++++++"}}) {
        SCOPED_TRACE(c.row);
        ASSERT_EQ(xos_HostFail("xos_SemBCreate", c.skip, c.times), 0);
        std::string results;
        for (int i = 0; i < 6; ++i) {
            xos_Sem const sem = xos_SemBCreate(1);
            results += sem != 0 ? '+' : '-';
            xos_SemDestroy(sem);
        }
        EXPECT_EQ(results, c.expected);
    }
}

TEST_F(HostFaults, replaces_an_earlier_request_for_the_same_function) {
    xos_HostFail("xos_SemMCreate", 0, 5);
    xos_HostFail("xos_SemMCreate", 1, 1);
    EXPECT_NE(xos_SemMCreate(), 0u);
    EXPECT_EQ(xos_SemMCreate(), 0u);
    EXPECT_NE(xos_SemMCreate(), 0u);
}

TEST_F(HostFaults, takes_all_requests_back) {
    xos_HostFail("xos_SemMCreate", 0, 5);
    xos_HostFail("xos_SemBCreate", 2, 5);
    xos_HostFailClear();
    EXPECT_NE(xos_SemMCreate(), 0u);
    EXPECT_NE(xos_SemBCreate(1), 0u);
}

TEST_F(HostFaults, counts_skipped_calls_over_all_threads) {
    constexpr int THREADS = 4;
    constexpr int CALLS = 500;
    xos_HostFail("xos_SemDestroy", 300, 700);
    std::atomic<int> failed{0};
    std::vector<std::thread> threads;
    for (int i = 0; i < THREADS; ++i) {
        threads.emplace_back([&] {
            for (int j = 0; j < CALLS; ++j) { failed += xos_SemDestroy(xos_SemMCreate()) == 0 ? 0 : 1; }
        });
    }
    for (std::thread& thread : threads) { thread.join(); }
    EXPECT_EQ(failed, 700);
}

/// Each call made in full, good where nothing is injected.
/// \return whether it gave its failure value
struct Failure {
    char const* name;
    std::function<bool()> fails;
};

TEST_F(HostFaults, gives_each_functions_failure_value_and_the_last_error) {
    constexpr xos_Task NO_TASK = ~xos_Task{0};
    Scratch const scratch;
    put(scratch / "on.cfg", "key = on\n");
    xos_HostSetConfigDir(scratch.path().c_str());
    xos_HostSetRoot("/anywhere");
    xos_HostSetResolver([](void*, char const*) -> void* { return nullptr; });
    xos_Sem const mutex = xos_SemMCreate();
    xos_Sem const binary = xos_SemBCreate(1);
    std::uint32_t word = 0;
    xos_TaskParams params{};
    params.entry = doNothing;
    std::int64_t code = 0;
    void* out = nullptr;
    put(scratch / "source", "text");
    std::string const url = "file:///" + (scratch / "source").substr(scratch.path()[0] == '/' ? 1 : 0);
    cfg_Group* const group = cfg_GroupLoadFromFile("on", 0, 0, 0);
    ASSERT_NE(group, nullptr);
    Failure const failures[] = {
        {"xos_SemMCreate", [] { return xos_SemMCreate() == 0; }},
        {"xos_SemBCreate", [] { return xos_SemBCreate(0) == 0; }},
        {"xos_SemNamedMutexCreate", [&] { return xos_SemNamedMutexCreate(-7, 0, 0, &word) == 0; }},
        {"xos_SemTake", [&] { return xos_SemTake(mutex) != 0; }},
        {"xos_SemGive", [&] { return xos_SemGive(binary) != 0; }},
        {"xos_SemDestroy", [] { return xos_SemDestroy(xos_SemMCreate()) != 0; }},
        {"xos_TaskCreate", [&] { return xos_TaskCreate(&params) == NO_TASK; }},
        {"xos_FileSystemRoot", [] { return *xos_FileSystemRoot() == '\0'; }},
        {"xos_ShellExecuteEx", [&] { return xos_ShellExecuteEx("exit 0", &code) != 0; }},
        {"xos_LibraryLoad", [] { return xos_LibraryLoad(libraryFile("hq_basis").c_str()) == nullptr; }},
        {"xos_BasicsParamLookup", [&] { return xos_BasicsParamLookup(0xFFFF8006, &out, sizeof out) < 1; }},
        {"cfg_GroupLoadFromFile",
         [] {
             cfg_Group* const loaded = cfg_GroupLoadFromFile("on", 0, 0, 0);
             cfg_GroupDelete(loaded, 0);
             return loaded == nullptr;
         }},
        {"cfg_KeyGetOpt_Bool", [&] { return cfg_KeyGetOpt_Bool(group, "key", 0) == 0; }},
        {"xos_URLGet", [&] { return xos_URLGet(url.c_str(), (scratch / "target").c_str(), nullptr, nullptr) != 0; }},
        {"HQ_Basis::AlertTimer::New", [] { return HQ_Basis::AlertTimer::New(60'000, onceAMinute, nullptr) == 0; }},
    };
    for (Failure const& failure : failures) {
        SCOPED_TRACE(failure.name);
        EXPECT_FALSE(failure.fails());
        ASSERT_EQ(xos_HostFail(failure.name, 0, 1), 0);
        clearSystemError();
        EXPECT_TRUE(failure.fails());
        EXPECT_EQ(systemError(), INJECTED_ERROR);
        EXPECT_FALSE(failure.fails());
    }
    cfg_GroupDelete(group, 0);
    xos_HostSetConfigDir(nullptr);
    xos_HostSetRoot(nullptr);
    xos_HostSetResolver(nullptr);
}

TEST_F(HostFaults, does_nothing_in_a_call_that_it_fails) {
    Scratch const scratch;
    put(scratch / "source", "text");
    xos_HostFail("xos_URLGet", 0, 1);
    std::string const url = "file:///" + (scratch / "source").substr(scratch.path()[0] == '/' ? 1 : 0);
    EXPECT_NE(xos_URLGet(url.c_str(), (scratch / "target").c_str(), nullptr, nullptr), 0);
    EXPECT_EQ(scratch.content(), Names{"source"});

    xos_HostFail("xos_TaskCreate", 0, 1);
    std::atomic<bool> ran{false};
    xos_TaskParams params{};
    params.entry = [](void* flag) { *static_cast<std::atomic<bool>*>(flag) = true; };
    params.argument = &ran;
    xos_TaskCreate(&params);
    xos_TaskSleep(20);
    EXPECT_FALSE(ran);

    xos_Sem const sem = xos_SemMCreate();
    xos_HostFail("xos_SemDestroy", 0, 1);
    EXPECT_NE(xos_SemDestroy(sem), 0);
    EXPECT_EQ(xos_SemTake(sem), 0) << "still there";
    EXPECT_EQ(xos_SemGive(sem), 0);
    EXPECT_EQ(xos_SemDestroy(sem), 0);
}

TEST_F(HostFaults, takes_failures_from_the_environment) {
    struct Case {
        Row row;
        char const* faults;
        char const* expected;
    };
    Scratch const scratch;
    for (Case const& c : {
             Case{{}, "xos_SemMCreate:0:1", "-++++++++"},
             Case{{}, "xos_SemMCreate:2:3,HQ_Basis::AlertTimer::New:1:1", "++---++-+"},
             Case{{}, "nonsense,xos_SemMCreate:1:1", "+-+++++++"},
             Case{{}, "xos_SemMCreate:1,xos_SemMCreate:x:1,xos_SemMCreate:1:1x,,:0:1,xos_MsCount:0:1", "+++++++++"},
             Case{{}, "xos_SemMCreate:5:4294967295", "+++++-+++"},
             Case{{}, "", "+++++++++"},
         }) {
        SCOPED_TRACE(c.row);
        Child child{programBeside("host_child"), {"failures", scratch / "results"}, {{"XOS_FAULTS", c.faults}}};
        ASSERT_EQ(child.wait(), 0);
        EXPECT_EQ(textOf(scratch / "results"), c.expected);
    }
}

} // namespace
