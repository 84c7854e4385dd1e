#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"
#include "tests/support/system_error.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <chrono>
#include <cstdint>
#include <cstring>
#include <string>
#include <thread>

namespace {

using namespace std::chrono_literals;

bool waitForText(std::string const& path, std::string const& start) {
    auto const end = std::chrono::steady_clock::now() + 30s;
    while (textOf(path).substr(0, start.size()) != start) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::sleep_for(2ms);
    }
    return true;
}

TEST(HostShell, waits_and_gives_the_exit_code) {
    struct Case {
        Row row;
        char const* command;
        std::int64_t code;
    };
    for (Case const& c : {Case{{}, "exit 0", 0}, Case{{}, "exit 1", 1}, Case{{}, "exit 42", 42},
                          Case{{}, "cd & exit 5", 5}, Case{{}, "cd & ", 0}, Case{{}, "", 0}}) {
        SCOPED_TRACE(c.row);
        std::int64_t code = 99;
        EXPECT_EQ(xos_ShellExecuteEx(c.command, &code), 0);
        EXPECT_EQ(code, c.code);
    }
}

TEST(HostShell, succeeds_whatever_the_command_does) {
    std::int64_t code = 0;
    EXPECT_EQ(xos_ShellExecuteEx("no-such-command-anywhere", &code), 0);
    EXPECT_NE(code, 0);
    EXPECT_EQ(xos_ShellExecuteEx("exit 3", nullptr), 0);
}

TEST(HostShell, fails_without_a_command_line) {
    std::int64_t code = 99;
    clearSystemError();
    EXPECT_NE(xos_ShellExecuteEx(nullptr, &code), 0);
    EXPECT_NE(systemError(), 0);
    EXPECT_EQ(code, 99);
}

TEST(HostShell, does_not_wait_without_a_slot) {
    Scratch const scratch;
    auto const start = std::chrono::steady_clock::now();
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + scratch.path() + "& echo first>one").c_str(), nullptr), 0);
    EXPECT_TRUE(waitForText(scratch / "one", "first"));
    EXPECT_LT(std::chrono::steady_clock::now() - start, 30s);
}

class HostShellDirectory : public testing::TestWithParam<char const*> {};

TEST_P(HostShellDirectory, is_changed_to_before_the_command_runs) {
    Scratch const scratch;
    std::string const folder = scratch / GetParam();
    makeFolder(folder);
    std::int64_t code = 99;
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + folder + "& echo there>mark").c_str(), &code), 0);
    EXPECT_EQ(code, 0);
    EXPECT_EQ(textOf(folder + "/mark").substr(0, 5), "there");
}

INSTANTIATE_TEST_SUITE_P(Names, HostShellDirectory,
                         testing::Values("plain", "with blank", "R&D", "it's", "100%", "-", "a(b)", "deep/er"));

TEST(HostShell, runs_no_command_when_the_directory_fails) {
    Scratch const scratch;
    std::int64_t code = 0;
    std::string const mark = scratch / "mark";
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + (scratch / "missing") + "& echo ran>" + mark).c_str(), &code), 0);
    EXPECT_NE(code, 0);
    EXPECT_FALSE(exists(mark));
    put(scratch / "file", "");
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + (scratch / "file") + "& echo ran>" + mark).c_str(), &code), 0);
    EXPECT_NE(code, 0);
    EXPECT_FALSE(exists(mark));
}

TEST(HostShell, takes_a_backslash_for_a_separator) {
    Scratch const scratch;
    makeFolder(scratch / "a/b");
    std::int64_t code = 99;
    EXPECT_EQ(xos_ShellExecuteEx(("cd " + scratch.path() + "\\a\\b& echo there>mark").c_str(), &code), 0);
    EXPECT_EQ(textOf(scratch / "a/b/mark").substr(0, 5), "there");
}

} // namespace
