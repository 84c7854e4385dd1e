#include "host/xos_basics/files/path_posix.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

namespace {

TEST(HostPathPosix, takes_both_slash_kinds_and_cuts_those_at_the_end_of_an_entry) {
    struct Case {
        Row row;
        char const* path;
        char const* system;
        char const* entry;
    };
    for (Case const& c : {
             Case{{}, "", "", ""},
             Case{{}, "a", "a", "a"},
             Case{{}, "a\\b/c", "a/b/c", "a/b/c"},
             Case{{}, "a\\", "a/", "a"},
             Case{{}, "/a//\\", "/a///", "/a"},
             Case{{}, "\\\\", "//", "/"},
             Case{{}, "/", "/", "/"},
             Case{{}, "a/.", "a/.", "a/."},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(host::systemPath(c.path), c.system);
        EXPECT_EQ(host::entryPath(c.path), c.entry);
    }
}

TEST(HostPathPosix, keeps_the_error_of_a_failure_across_a_clean_up) {
    EXPECT_FALSE(host::failWith(ENOENT));
    {
        host::KeepErrno const keep;
        errno = EBADF;
    }
    EXPECT_EQ(errno, ENOENT);
}

} // namespace
