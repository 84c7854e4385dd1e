#include <zor_basis/flat.h>

#include <xos_host.h>

#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstdint>
#include <string>
#include <vector>

namespace {

/// The rests so far, in milliseconds.
std::vector<std::uint32_t> rests;

struct RunCommand : testing::Test {
    RunCommand() {
        rests.clear();
        xos_HostCallsReset();
    }
    ~RunCommand() override { xos_HostFailClear(); }

    /// The command line and the slot of the last call.
    static std::string lastLine() {
        std::string const call = xos_HostLastCall("xos_ShellExecuteEx");
        return call.substr(1, call.rfind("\", ") - 1);
    }
    static bool lastHadSlot() {
        std::string const call = xos_HostLastCall("xos_ShellExecuteEx");
        return call.substr(call.rfind(' ') + 1) != "null";
    }
};

} // namespace

/// Takes the place of the platform's, so that no test waits.
extern "C" void xos_TaskSleep(std::uint32_t ms) { rests.push_back(ms); }

TEST(Flat, has_the_plain_functions_of_walks_for_cplusplus) {
    ZOR_Basis::FPath found;
    EXPECT_FALSE(zbFindFile("no such folder", "*", ZOR_Basis::LOOK_FILES, found, true, true));
}

TEST_F(RunCommand, breathes) {
    Scratch const scratch;
    EXPECT_TRUE(ZB_runCommand("echo x>made", scratch.path().c_str(), false));
    EXPECT_EQ(scratch.content(), Names{"made"});
    EXPECT_TRUE(rests.empty());
}

TEST_F(RunCommand, is_true_whatever_becomes_of_the_command) {
    Scratch const scratch;
    EXPECT_TRUE(ZB_runCommand("exit 3", scratch.path().c_str(), false));
    EXPECT_TRUE(ZB_runCommand("echo x>made", (scratch / "missing").c_str(), false));
    EXPECT_EQ(scratch.content(), Names{});
}

TEST_F(RunCommand, builds_one_line) {
    xos_HostFail("xos_ShellExecuteEx", 0, ~0U); // nothing is run
    std::string const longText(400, 'x');
    struct Case {
        Row row;
        char const *command, *directory;
        std::string line;
    };
    for (Case const& c : {
             Case{{}, "run.bat", "D:\\jobs", "cd D:\\jobs& run.bat"},
             Case{{}, "run a & b", "/jobs and more/", "cd /jobs and more/& run a & b"},
             Case{{}, nullptr, "dir", "cd dir& "},
             Case{{}, "", "dir", "cd dir& "},
             Case{{}, longText.c_str(), longText.c_str(), "cd " + longText + "& " + longText},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_FALSE(ZB_runCommand(c.command, c.directory, true));
        EXPECT_EQ(lastLine(), c.line);
    }
}

TEST_F(RunCommand, Kept_flat_03_changes_to_no_directory_without_one) {
    EXPECT_TRUE(ZB_runCommand("exit 0", nullptr, false));
    EXPECT_EQ(lastLine(), "cd & exit 0");
    EXPECT_TRUE(ZB_runCommand("exit 0", "", false));
    EXPECT_EQ(lastLine(), "cd & exit 0");
    EXPECT_TRUE(ZB_runCommand(nullptr, nullptr, true));
    EXPECT_EQ(lastLine(), "cd & ");
}

TEST_F(RunCommand, asks_for_a_result_or_not) {
    EXPECT_TRUE(ZB_runCommand("exit 0", nullptr, true));
    EXPECT_FALSE(lastHadSlot());
    EXPECT_TRUE(ZB_runCommand("exit 0", nullptr, false));
    EXPECT_TRUE(lastHadSlot());
}

TEST_F(RunCommand, tries_five_times_with_a_rest_after_each) {
    for (std::uint32_t failures = 0; failures <= 7; ++failures) {
        SCOPED_TRACE(failures);
        rests.clear();
        xos_HostCallsReset();
        xos_HostFail("xos_ShellExecuteEx", 0, failures);
        EXPECT_EQ(ZB_runCommand("exit 0", nullptr, false), failures < 5);
        EXPECT_EQ(rests, std::vector<std::uint32_t>(std::min(failures, 5U), 500));
        EXPECT_EQ(xos_HostCalls("xos_ShellExecuteEx"), std::min(failures + 1, 5U));
    }
}
