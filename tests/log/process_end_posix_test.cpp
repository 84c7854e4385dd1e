#include "tests/support/child.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <filesystem>

// On Windows the library learns of every end except `TerminateProcess`.
TEST(ProcessEndOfLogsPosix, is_lost_where_the_process_ends_at_once) {
    Scratch const root;
    EXPECT_EQ(run({"log_end_child", {"sudden"}, {{"XOS_ROOT", root.path()}}, root.path()}).exitCode, 0);
    EXPECT_TRUE(std::filesystem::exists(root / "tmp/zb_log/child"));
    EXPECT_FALSE(std::filesystem::exists(root / "tmp/zb_log/child/0.log"));
}

TEST(ProcessEndOfLogsPosix, is_not_written_a_second_time_by_a_copy_of_the_process) {
    Scratch const root;
    ChildResult const result = run({"log_fork_child", {}, {{"XOS_ROOT", root.path()}}, root.path()});
    EXPECT_EQ(result.exitCode, 0);
    EXPECT_EQ(textOf(root / "tmp/zb_log/child/0.log"), "line 1\n");
}
