/// \file
/// `root_child` under a root. The root folder is found once in a process, so each case has a child of its own.

#ifndef TESTS_SUPPORT_ROOT_CHILD_H
#define TESTS_SUPPORT_ROOT_CHILD_H

#include "tests/support/child.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

/// \param folder  where the child runs; empty: here
/// \return what the steps print; a child that a sanitizer has ended fails the test
inline std::string stepsUnder(std::string const& root, std::vector<std::string> const& steps,
                              std::string const& folder = {}, std::string const& faults = {}) {
    ChildResult const result = run({"root_child", steps, {{"XOS_ROOT", root}, {"XOS_FAULTS", faults}}, folder});
    EXPECT_EQ(result.exitCode, 0);
    return result.output;
}

#endif
