// Streams that cannot be made, for Linux; the steps are the same for Windows.

#include "host/xos_url/target_file.h"
#include "host/xos_url/url_files.h"

#include "tests/support/scratch.h"
#include "tests/support/thread_facts.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <dlfcn.h>

namespace {

int refusals = 0;

} // namespace

/// Stands in for the system's own: fails as often as a test asks it to.
extern "C" [[gnu::visibility("default")]] std::FILE* fdopen(int file, char const* mode) noexcept {
    if (refusals > 0) {
        --refusals;
        errno = ENOMEM;
        return nullptr;
    }
    static auto const systems = reinterpret_cast<std::FILE* (*)(int, char const*)>(::dlsym(RTLD_NEXT, "fdopen"));
    return systems(file, mode);
}

TEST(HostUrlFilesPosix, leave_neither_a_file_nor_a_descriptor_without_a_stream) {
    Scratch const scratch;
    put(scratch / "source", "text");
    std::size_t const before = openHandles();
    refusals = 2;
    errno = 0;
    EXPECT_EQ(host::createNewFile(scratch / "new"), nullptr);
    EXPECT_EQ(errno, ENOMEM);
    errno = 0;
    EXPECT_EQ(host::openRegularFile(scratch / "source"), nullptr);
    EXPECT_EQ(errno, ENOMEM);
    EXPECT_EQ(openHandles(), before);
    EXPECT_EQ(scratch.content(), Names{"source"});
}

TEST(HostUrlFilesPosix, leave_nothing_of_a_target_that_comes_to_be_open_later) {
    Scratch const scratch;
    {
        host::TargetFile file{scratch / "target"};
        refusals = 3;
        ASSERT_TRUE(file.open());
        EXPECT_TRUE(file.commit());
    }
    EXPECT_EQ(scratch.content(), Names{"target"});
}
