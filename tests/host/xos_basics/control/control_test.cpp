#include "basis/platform/xos_basics.h"
#include "host/include/xos_host.h"
#include "tests/host/xos_basics/control/recorded_calls.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <string>
#include <thread>
#include <vector>

namespace {

struct HostControl : RecordedCalls {};

TEST_F(HostControl, counts_remembers_and_fails_a_call) {
    ASSERT_EQ(xos_HostFail("xos_SemMCreate", 0, 1), 0);
    EXPECT_EQ(xos_SemMCreate(), 0u);
    xos_Sem const sem = xos_SemMCreate();
    EXPECT_NE(sem, 0u);
    EXPECT_EQ(xos_SemDestroy(sem), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemMCreate"), 2u);
    EXPECT_EQ(lastCall("xos_SemDestroy"), hexadecimal(sem));
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

} // namespace
