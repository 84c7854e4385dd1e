#include "tests/system/ending.h"

TEST(LibraryEndingPosix, serves_threads_that_run_until_the_process_is_gone) {
    for (int i = 0; i < 10; ++i) expectUseToTheEnd("end");
}
