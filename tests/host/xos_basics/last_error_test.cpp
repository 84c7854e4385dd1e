#include "host/xos_basics/last_error.h"

#include "tests/support/system_error.h"

#include <gtest/gtest.h>

#include <set>

namespace {

using host::Error;

TEST(HostLastError, says_each_error_by_a_code_of_its_own) {
    std::set<int> codes;
    for (Error const error : {Error::INJECTED, Error::BAD_HANDLE, Error::BAD_ARGUMENT, Error::NOT_OWNER,
                              Error::NOT_FOUND, Error::NO_MEMORY}) {
        clearSystemError();
        host::setLastError(error);
        EXPECT_NE(systemError(), 0) << static_cast<int>(error);
        codes.insert(systemError());
    }
    EXPECT_EQ(codes.size(), 6u);
}

TEST(HostLastError, of_an_injected_failure_is_the_documented_one) {
    host::setLastError(Error::INJECTED);
    EXPECT_EQ(systemError(), INJECTED_ERROR);
    // Both systems have the same code for a file that is missing.
    host::setLastError(Error::NOT_FOUND);
    EXPECT_EQ(systemError(), 2);
}

} // namespace
