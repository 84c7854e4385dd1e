/// \file
/// A process that uses the library until its end.

#ifndef TESTS_SYSTEM_ENDING_H
#define TESTS_SYSTEM_ENDING_H

#include "tests/support/child.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

/// \param how  what its threads do; see ending_child.cpp
inline void expectUseToTheEnd(char const* how) {
    Scratch const root;
    ChildResult const result = run({"ending_child", {how}, {{"XOS_ROOT", root.path()}}, root.path()});
    EXPECT_EQ(result.exitCode, 0);
    EXPECT_EQ(result.output, "used to the end\n");
    std::string const lines = textOf(root / "tmp/zb_log/ending/0.log");
    EXPECT_NE(lines.find("line of 4"), std::string::npos) << lines;
}

#endif
