#include "host/xos_basics/wait/word_wait.h"

#include "tests/support/system_error.h"

#include <gtest/gtest.h>

#include <atomic>
#include <thread>

namespace {

TEST(HostWordWait, returns_when_the_word_has_another_value) {
    std::atomic<std::uint32_t> word{1};
    host::waitWhile(word, 0);
    EXPECT_EQ(word, 1u);
}

TEST(HostWordWait, sleeps_until_it_is_woken) {
    std::atomic<std::uint32_t> word{0};
    std::atomic<bool> isAwake{false};
    std::thread sleeper([&] {
        while (word == 0) { host::waitWhile(word, 0); }
        isAwake = true;
    });
    std::this_thread::sleep_for(std::chrono::milliseconds(20));
    EXPECT_FALSE(isAwake);
    word = 1;
    host::wakeOne(word);
    sleeper.join();
    EXPECT_TRUE(isAwake);
}

TEST(HostWordWait, keeps_the_last_error) {
    std::atomic<std::uint32_t> word{1};
    clearSystemError();
    host::waitWhile(word, 0);
    host::wakeOne(word);
    EXPECT_EQ(systemError(), 0);
}

} // namespace
