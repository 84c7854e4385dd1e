/// \file
/// Calls that fail, and the last error that they leave.

#ifndef TESTS_SYSTEM_REASONS_TEST_H
#define TESTS_SYSTEM_REASONS_TEST_H

#include "tests/support/scratch.h"
#include "tests/support/system_error.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <functional>
#include <string>

/// A folder with two files, an empty folder, and two folders with a file of the same name.
struct Place {
    Place() {
        put(scratch / "file", "text");
        put(scratch / "other", "other");
        makeFolder(scratch / "empty");
        makeFolder(scratch / "full");
        put(scratch / "full/file", "text");
        makeFolder(scratch / "twin");
        put(scratch / "twin/file", "text");
    }

    std::string at(std::string const& name) const { return scratch / name; }

    Scratch scratch;
};

/// One way for a call to fail.
struct Failure {
    Row row;
    /// On Linux and on Windows.
    int posix, windows;
    /// \return whether the call succeeded
    std::function<bool(Place const&)> call;
    /// A call of the platform layer that is made to fail meanwhile.
    char const* injected = nullptr;
    std::uint32_t times = 1;
};

/// Checks each failure in a folder of its own.
inline void expectReasons(std::initializer_list<Failure> failures) {
    bool const isWindows = INJECTED_ERROR == 31;
    for (Failure const& failure : failures) {
        SCOPED_TRACE(failure.row);
        Place const place;
        if (failure.injected != nullptr) { ASSERT_EQ(xos_HostFail(failure.injected, 0, failure.times), 0); }
        clearSystemError();
        bool const succeeded = failure.call(place);
        int const error = systemError();
        xos_HostFailClear();
        EXPECT_FALSE(succeeded);
        EXPECT_EQ(error, isWindows ? failure.windows : failure.posix);
    }
}

#endif
