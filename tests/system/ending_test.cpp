// The library before and after `main`, in processes of their own.

#include "tests/support/child.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

TEST(LibraryLoading, calls_no_function_of_the_platform_layer) {
    ChildResult const result = run({"ending_child", {"begin"}, {}, {}});
    EXPECT_EQ(result.exitCode, 0);
    EXPECT_EQ(result.output, "no other\n");
}

TEST(LibraryEnding, serves_static_destructors_while_other_threads_run) {
    for (int i = 0; i < 10; ++i) {
        Scratch const root;
        ChildResult const result = run({"ending_child", {"end"}, {{"XOS_ROOT", root.path()}}, root.path()});
        EXPECT_EQ(result.exitCode, 0);
        EXPECT_EQ(result.output, "used to the end\n");
        EXPECT_NE(textOf(root / "tmp/zb_log/ending/0.log").find("line of 4"), std::string::npos);
    }
}
