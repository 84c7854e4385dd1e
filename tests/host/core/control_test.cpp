#include "host/include/xos_host.h"

#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "basis/platform/xos_url.h"
#include "tests/host/support/child.h"
#include "tests/host/support/system_error.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <atomic>
#include <functional>
#include <string>
#include <thread>
#include <vector>

namespace {

class HostControl : public testing::Test {
protected:
    HostControl() {
        xos_HostFailClear();
        xos_HostCallsReset();
    }
    ~HostControl() override { xos_HostFailClear(); }
};

constexpr char const* const CANNOT_FAIL[] = {"xos_MsCount",         "xos_StrCmp",   "xos_TaskSleep",  "xos_Assert",
                                             "xos_DirForceCaseAny", "xos_DirClose", "cfg_GroupDelete"};

constexpr char const* const CAN_FAIL[] = {"xos_SemMCreate",
                                          "xos_SemBCreate",
                                          "xos_SemNamedMutexCreate",
                                          "xos_SemTake",
                                          "xos_SemGive",
                                          "xos_SemDestroy",
                                          "xos_TaskCreate",
                                          "xos_FileOpen",
                                          "xos_FileCloseEx",
                                          "xos_FileReadEx",
                                          "xos_FileWriteEx",
                                          "xos_FileGetsEx",
                                          "xos_FileFlush",
                                          "xos_FileSeekEx",
                                          "xos_FileTellEx",
                                          "xos_FileRemove",
                                          "xos_FileCopy",
                                          "xos_FileMove",
                                          "xos_FileHardLink",
                                          "xos_FileStatByNameEx",
                                          "xos_DirCreateEx",
                                          "xos_DirRemove",
                                          "xos_DirCopy",
                                          "xos_DirMove",
                                          "xos_DirOpenEx",
                                          "xos_DirNextEx",
                                          "xos_FileSystemRoot",
                                          "xos_ShellExecuteEx",
                                          "xos_LibraryLoad",
                                          "xos_BasicsParamLookup",
                                          "cfg_GroupLoadFromFile",
                                          "cfg_KeyGetOpt_Bool",
                                          "xos_URLGet",
                                          "HQ_Basis::AlertTimer::New",
                                          "HQ_Basis::AlertTimer::Delete"};

std::string lastCall(char const* function) {
    char const* const text = xos_HostLastCall(function);
    return text == nullptr ? "no call" : text;
}

std::string hexadecimal(std::uint64_t number) {
    char text[32];
    std::snprintf(text, sizeof text, "0x%llx", static_cast<unsigned long long>(number));
    return text;
}

void doNothing(void*) {}

std::uint32_t onceAMinute(HQ_Basis::AlertTimer::Alert const&) { return 60'000; }

TEST_F(HostControl, counts_remembers_and_fails_a_call) {
    ASSERT_EQ(xos_HostFail("xos_SemMCreate", 0, 1), 0);
    EXPECT_EQ(xos_SemMCreate(), 0u);
    xos_Sem const sem = xos_SemMCreate();
    EXPECT_NE(sem, 0u);
    EXPECT_EQ(xos_SemDestroy(sem), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 2u);
    EXPECT_EQ(lastCall("xos_SemDestroy"), hexadecimal(sem));
}

TEST_F(HostControl, refuses_to_fail_what_cannot_fail_or_does_not_exist) {
    for (char const* const name : CANNOT_FAIL) { EXPECT_EQ(xos_HostFail(name, 0, 1), -1) << name; }
    for (char const* const name : {"", "xos_FileMov", "xos_FileMoveEx", "New", "AlertTimer::New", "xos_HostFail"}) {
        EXPECT_EQ(xos_HostFail(name, 0, 1), -1) << name;
    }
    EXPECT_EQ(xos_HostFail(nullptr, 0, 1), -1);
}

TEST_F(HostControl, accepts_every_function_that_can_fail) {
    for (char const* const name : CAN_FAIL) { EXPECT_EQ(xos_HostFail(name, 3, 1), 0) << name; }
}

TEST_F(HostControl, fails_after_the_skipped_calls_and_so_many_times) {
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

TEST_F(HostControl, replaces_an_earlier_request_for_the_same_function) {
    xos_HostFail("xos_SemMCreate", 0, 5);
    xos_HostFail("xos_SemMCreate", 1, 1);
    EXPECT_NE(xos_SemMCreate(), 0u);
    EXPECT_EQ(xos_SemMCreate(), 0u);
    EXPECT_NE(xos_SemMCreate(), 0u);
}

TEST_F(HostControl, takes_all_requests_back) {
    xos_HostFail("xos_SemMCreate", 0, 5);
    xos_HostFail("xos_SemBCreate", 2, 5);
    xos_HostFailClear();
    EXPECT_NE(xos_SemMCreate(), 0u);
    EXPECT_NE(xos_SemBCreate(1), 0u);
}

TEST_F(HostControl, counts_skipped_calls_over_all_threads) {
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

TEST_F(HostControl, gives_each_functions_failure_value_and_the_last_error) {
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

TEST_F(HostControl, does_nothing_in_a_call_that_it_fails) {
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

TEST_F(HostControl, counts_calls_that_fail_and_calls_with_bad_arguments) {
    xos_HostFail("xos_SemTake", 0, 1);
    xos_SemTake(0);
    xos_SemTake(0);
    EXPECT_EQ(xos_HostCalls("xos_SemTake"), 2u);
    EXPECT_EQ(xos_HostCalls("xos_SemGive"), 0u);
    EXPECT_EQ(xos_HostCalls("no such function"), 0u);
    EXPECT_EQ(xos_HostCalls(nullptr), 0u);
}

TEST_F(HostControl, forgets_counts_and_last_calls_at_a_reset) {
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

TEST_F(HostControl, has_no_last_call_of_what_was_not_called_or_does_not_exist) {
    EXPECT_EQ(xos_HostLastCall("xos_SemMCreate"), nullptr);
    EXPECT_EQ(xos_HostLastCall("no such function"), nullptr);
    EXPECT_EQ(xos_HostLastCall(nullptr), nullptr);
}

TEST_F(HostControl, writes_last_calls_as_documented) {
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

TEST_F(HostControl, gives_the_seven_fields_of_a_task) {
    xos_TaskParams params{doNothing, nullptr, 0, -9, 0, "MTQ_Dat::start", 0};
    xos_TaskCreate(&params);
    EXPECT_EQ(lastCall("xos_TaskCreate"),
              hexadecimal(reinterpret_cast<std::uintptr_t>(doNothing)) + ", null, 0x0, -9, 0, \"MTQ_Dat::start\", 0");
    xos_TaskCreate(nullptr);
    EXPECT_EQ(lastCall("xos_TaskCreate"), "null, null, 0x0, 0, 0, null, 0");
}

TEST_F(HostControl, copies_texts_of_any_length) {
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

TEST_F(HostControl, knows_the_last_call_of_whatever_thread) {
    xos_StrCmp("main", "1");
    for (int i = 0; i < 50; ++i) {
        std::string const number = std::to_string(i);
        std::thread([&] { xos_StrCmp("thread", number.c_str()); }).join();
        EXPECT_EQ(lastCall("xos_StrCmp"), "\"thread\", \"" + number + '"');
        xos_StrCmp("main", number.c_str());
        EXPECT_EQ(lastCall("xos_StrCmp"), "\"main\", \"" + number + '"');
    }
    EXPECT_EQ(xos_HostCalls("xos_StrCmp"), 101u);
}

TEST_F(HostControl, knows_the_last_take_of_whatever_thread) {
    xos_Sem const first = xos_SemMCreate();
    xos_Sem const second = xos_SemMCreate();
    for (int i = 0; i < 50; ++i) {
        xos_SemTake(first);
        xos_SemGive(first);
        std::thread([&] {
            xos_SemTake(second);
            xos_SemGive(second);
        }).join();
        EXPECT_EQ(lastCall("xos_SemTake"), hexadecimal(second));
        EXPECT_EQ(lastCall("xos_SemGive"), hexadecimal(second));
        xos_SemTake(first);
        EXPECT_EQ(lastCall("xos_SemTake"), hexadecimal(first));
        EXPECT_EQ(lastCall("xos_SemGive"), hexadecimal(second));
        xos_SemGive(first);
    }
    xos_SemDestroy(first);
    xos_SemDestroy(second);
}

/// Two threads that run one after the other, by turns, without a function of the layer between them.
class Alternation {
public:
    void await(int turn) const {
        while (turn_.load() != turn) { std::this_thread::yield(); }
    }
    void pass() { ++turn_; }

private:
    std::atomic<int> turn_{0};
};

TEST_F(HostControl, orders_the_calls_of_threads_however_they_synchronise) {
    constexpr int TURNS = 100;
    Alternation turns;
    std::thread other([&] {
        for (int turn = 1; turn < TURNS; turn += 2) {
            turns.await(turn);
            xos_FileTellEx(0, turn);
            turns.pass();
        }
    });
    for (int turn = 0; turn < TURNS; turn += 2) {
        turns.await(turn);
        // Now and then only: the order must hold where nothing is queried in between, too.
        if (turn % 10 == 0 && turn != 0) { EXPECT_EQ(lastCall("xos_FileTellEx"), "0x0, " + std::to_string(turn - 1)); }
        xos_FileTellEx(0, turn);
        if (turn % 6 == 0) { EXPECT_EQ(lastCall("xos_FileTellEx"), "0x0, " + std::to_string(turn)); }
        turns.pass();
    }
    turns.await(TURNS);
    EXPECT_EQ(lastCall("xos_FileTellEx"), "0x0, " + std::to_string(TURNS - 1));
    other.join();
}

TEST_F(HostControl, counts_the_asking_threads_quick_call_as_the_later_one_until_an_era_ends) {
    Alternation turns;
    std::thread other([&] {
        xos_MsCount();
        turns.pass();
        turns.await(2);
        xos_StrCmp("other", "");
        turns.pass();
        turns.await(4);
    });
    turns.await(1);
    xos_StrCmp("asking", "1");
    turns.pass();
    turns.await(3);
    EXPECT_EQ(lastCall("xos_StrCmp"), "\"asking\", \"1\"") << "although the other called after it";
    EXPECT_EQ(lastCall("xos_StrCmp"), "\"other\", \"\"") << "after a query";
    xos_StrCmp("asking", "2");
    turns.pass();
    other.join();
    EXPECT_EQ(lastCall("xos_StrCmp"), "\"asking\", \"2\"") << "the other called before the query";
}

TEST_F(HostControl, orders_quick_calls_by_the_begin_and_end_of_a_task) {
    std::atomic<bool> isDone{false};
    for (int i = 0; i < 20; ++i) {
        xos_StrCmp("creator", "before");
        xos_TaskParams params{};
        params.entry = [](void* done) {
            xos_StrCmp("task", "last");
            static_cast<std::atomic<bool>*>(done)->store(true);
        };
        params.argument = &isDone;
        isDone = false;
        xos_TaskCreate(&params);
        while (!isDone) { std::this_thread::yield(); }
        EXPECT_EQ(lastCall("xos_StrCmp"), "\"task\", \"last\"") << i;
    }
}

TEST_F(HostControl, counts_the_calls_of_all_threads_living_or_not) {
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

TEST_F(HostControl, reads_whole_numbers_while_another_thread_calls) {
    std::atomic<bool> stop{false};
    std::thread other([&stop] {
        for (int i = 0; !stop; i = (i + 1) % 1000) { xos_FileReadEx(0, nullptr, static_cast<std::uint64_t>(i), i, i); }
    });
    while (xos_HostCalls("xos_FileReadEx") == 0) { std::this_thread::yield(); }
    for (int i = 0; i < 100'000; ++i) {
        std::string const text = lastCall("xos_FileReadEx");
        std::size_t const last = text.rfind(' ');
        std::string const number = text.substr(last + 1);
        ASSERT_EQ(text, "0x0, null, " + number + ", " + number + ", " + number);
    }
    stop = true;
    other.join();
}

TEST_F(HostControl, reads_whole_calls_while_others_make_them) {
    std::atomic<bool> stop{false};
    std::vector<std::thread> threads;
    for (char const letter : {'a', 'b', 'c'}) {
        threads.emplace_back([&stop, letter] {
            for (std::size_t length = 1; !stop; length = length % 700 + 13) {
                std::string const text(length, letter);
                xos_StrCmp(text.c_str(), text.c_str());
            }
        });
    }
    for (int good = 0; good < 2'000;) {
        std::string const text = lastCall("xos_StrCmp");
        if (text == "no call") {
            std::this_thread::yield();
            continue;
        }
        std::size_t const half = (text.size() - 2) / 2;
        ASSERT_EQ(text.substr(0, half), text.substr(half + 2)) << "both arguments are equal";
        ASSERT_EQ(text.find_first_not_of(text[1], 1), half - 1) << "and of one letter: " << text;
        if (++good % 500 == 0) xos_HostCallsReset();
    }
    stop = true;
    for (std::thread& thread : threads) { thread.join(); }
}

TEST_F(HostControl, keeps_the_text_of_a_last_call_until_the_threads_next_question) {
    xos_StrCmp("a", "b");
    char const* const text = xos_HostLastCall("xos_StrCmp");
    std::thread([] {
        xos_StrCmp("c", "d");
        xos_HostLastCall("xos_StrCmp");
    }).join();
    EXPECT_STREQ(text, "\"a\", \"b\"");
}

TEST_F(HostControl, takes_failures_from_the_environment) {
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
