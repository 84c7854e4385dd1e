// If the root is that of the whole file system, its path is empty.

#include "tests/support/child.h"

#include <gtest/gtest.h>

TEST(TimerMgrMgrOncePosix, reports_beneath_the_root_of_the_file_system) {
    // Both calls fail, so that nothing is created there.
    ChildResult const result = run({"timers_child",
                                    {"new", "report", "folder"},
                                    {{"XOS_ROOT", "/"}, {"XOS_FAULTS", "xos_DirCreateEx:0:9,xos_FileOpen:0:9"}},
                                    "/tmp"});
    EXPECT_EQ(result.exitCode, 0);
    EXPECT_EQ(result.output.find("report\nmade \"/timer\", "), 0u) << result.output;
    EXPECT_NE(result.output.find("\nopened \"/timer/"), std::string::npos) << result.output;
}
