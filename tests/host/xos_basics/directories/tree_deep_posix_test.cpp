// Trees deeper than any path can say, with few descriptors.

#include "basis/platform/xos_basics.h"
#include "tests/support/memory_folder_posix.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

constexpr int LEVELS = 2'500; // two bytes of a path each, and a path has at most 4,096

struct DescriptorLimit {
    explicit DescriptorLimit(rlim_t most) {
        ::getrlimit(RLIMIT_NOFILE, &before);
        rlimit const limit{most, before.rlim_max};
        ::setrlimit(RLIMIT_NOFILE, &limit);
    }
    ~DescriptorLimit() { ::setrlimit(RLIMIT_NOFILE, &before); }
    rlimit before{};
};

/// Makes directories named "d", one in the other, each with a file and an empty directory beside the next.
bool makeDeep(std::string const& top) {
    if (::mkdir(top.c_str(), 0755) != 0) return false;
    int here = ::open(top.c_str(), O_RDONLY | O_DIRECTORY);
    bool good = here >= 0;
    for (int level = 0; good && level < LEVELS; ++level) {
        int const file = ::openat(here, "f", O_WRONLY | O_CREAT, 0644);
        good = file >= 0 && ::close(file) == 0 && ::mkdirat(here, "z", 0755) == 0 && ::mkdirat(here, "d", 0755) == 0;
        int const next = ::openat(here, "d", O_RDONLY | O_DIRECTORY);
        ::close(here);
        here = next;
    }
    ::close(here);
    return good;
}

/// How many levels there are, and whether each holds what it should.
int depthOf(std::string const& top) {
    int here = ::open(top.c_str(), O_RDONLY | O_DIRECTORY);
    int depth = 0;
    while (::faccessat(here, "f", F_OK, 0) == 0 && ::faccessat(here, "z", F_OK, 0) == 0) {
        int const next = ::openat(here, "d", O_RDONLY | O_DIRECTORY);
        ::close(here);
        here = next;
        ++depth;
    }
    ::close(here);
    return depth;
}

} // namespace

TEST(HostDeepTreePosix, is_copied_moved_and_removed) {
    Scratch const scratch{memoryFolder()};
    ASSERT_TRUE(makeDeep(scratch / "deep"));
    {
        DescriptorLimit const limit{100};
        EXPECT_EQ(xos_DirCopy((scratch / "copy").c_str(), (scratch / "deep").c_str(), 0x200), 0);
        EXPECT_EQ(depthOf(scratch / "copy"), LEVELS);
        EXPECT_EQ(xos_DirCopy((scratch / "copy").c_str(), (scratch / "deep").c_str(), 0x201), 0);
        EXPECT_EQ(xos_DirMove((scratch / "copy").c_str(), (scratch / "deep").c_str(), 0x001), 0);
        EXPECT_EQ(depthOf(scratch / "copy"), LEVELS);
        EXPECT_EQ(xos_DirRemove((scratch / "copy").c_str(), 0x600), 0);
    }
    EXPECT_EQ(scratch.content(), Names{});
}

TEST(HostDeepTreePosix, leaves_nothing_when_its_copy_fails_at_the_bottom) {
    Scratch const scratch{memoryFolder()};
    ASSERT_TRUE(makeDeep(scratch / "deep"));
    makeFolder(scratch / "to");
    put(scratch / "to/f", "");
    EXPECT_NE(xos_DirCopy((scratch / "to").c_str(), (scratch / "deep").c_str(), 0x200), 0);
    EXPECT_EQ(scratch.content("to"), Names{"f"});
    {
        DescriptorLimit const limit{40};
        EXPECT_NE(xos_DirCopy((scratch / "copy").c_str(), (scratch / "deep").c_str(), 0x200), 0);
        EXPECT_EQ(errno, EMFILE);
    }
    EXPECT_FALSE(exists(scratch / "copy"));
    EXPECT_EQ(xos_DirRemove((scratch / "deep").c_str(), 0x600), 0);
    EXPECT_EQ(scratch.content(), (Names{"to/", "to/f"}));
}
