// The library before and after `main`, in processes of their own.

#include "tests/system/ending.h"

TEST(LibraryLoading, calls_no_function_of_the_platform_layer) {
    ChildResult const result = run({"ending_child", {"begin"}, {}, {}});
    EXPECT_EQ(result.exitCode, 0);
    EXPECT_EQ(result.output, "no other\n");
}

// Wine fails in its own code where threads that work with files end with their process.
TEST(LibraryEnding, serves_static_destructors_while_other_threads_run) {
    for (int i = 0; i < 10; ++i) expectUseToTheEnd("pause");
}
