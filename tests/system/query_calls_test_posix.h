/// \file
/// Gives the table of the system's calls back after each test.

#ifndef TESTS_SYSTEM_QUERY_CALLS_TEST_POSIX_H
#define TESTS_SYSTEM_QUERY_CALLS_TEST_POSIX_H

#include "basis/system/query_calls_posix.h"

#include <gtest/gtest.h>

struct QueryCallsTest : testing::Test {
    ~QueryCallsTest() override { ZOR_Basis::queryCalls = real; }

    ZOR_Basis::QueryCalls const real = ZOR_Basis::queryCalls;
};

#endif
