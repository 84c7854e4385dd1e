#include "basis/platform/xos_basics.h"
#include "tests/host/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/system_error.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>

namespace {

TEST(HostLibrary, is_loaded_by_path) {
    std::string const path = libraryFile("hq_basis");
    void* const library = xos_LibraryLoad(path.c_str());
    ASSERT_NE(library, nullptr);
    EXPECT_EQ(xos_LibraryLoad(path.c_str()), library) << "once loaded it stays the same";
}

TEST(HostLibrary, takes_both_slash_kinds) {
    std::string path = libraryFile("hq_basis");
    std::replace(path.begin(), path.end(), '/', '\\');
    EXPECT_NE(xos_LibraryLoad(path.c_str()), nullptr);
    std::replace(path.begin(), path.end(), '\\', '/');
    EXPECT_NE(xos_LibraryLoad(path.c_str()), nullptr);
}

TEST(HostLibrary, is_null_when_there_is_none) {
    Scratch const scratch;
    put(scratch / "text.so", "no library");
    std::string const text = scratch / "text.so";
    for (char const* const name : {"no-such-library", "", text.c_str(), static_cast<char const*>(nullptr)}) {
        clearSystemError();
        EXPECT_EQ(xos_LibraryLoad(name), nullptr);
        EXPECT_NE(systemError(), 0);
    }
}

} // namespace
