/// \file
/// The one way in which a test says that its case cannot hold where it runs. Skipped cases are counted and capped.

#ifndef TESTS_SUPPORT_SKIP_H
#define TESTS_SUPPORT_SKIP_H

#include <gtest/gtest.h>

/// Ends the test. \param reason  one line
#define CASE_CANNOT_HOLD(reason) GTEST_SKIP() << (reason)

#endif
