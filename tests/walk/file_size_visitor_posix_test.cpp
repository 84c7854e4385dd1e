// Sizes of trees with what only Linux has.

#include <zor_basis/walk.h>

#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <fcntl.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

using namespace ZOR_Basis;

namespace {

/// Lets the process open only so many descriptors more.
class FewDescriptors {
public:
    explicit FewDescriptors(rlim_t more) {
        int const next = ::open("/", O_PATH | O_CLOEXEC);
        ::close(next);
        ::getrlimit(RLIMIT_NOFILE, &usual_);
        rlimit few = usual_;
        few.rlim_cur = static_cast<rlim_t>(next) + more;
        ::setrlimit(RLIMIT_NOFILE, &few);
    }
    FewDescriptors(FewDescriptors const&) = delete;
    FewDescriptors& operator=(FewDescriptors const&) = delete;
    ~FewDescriptors() { ::setrlimit(RLIMIT_NOFILE, &usual_); }

private:
    rlimit usual_{};
};

} // namespace

TEST(FileSizeVisitorPosix, takes_a_backslash_in_a_name_for_a_slash) {
    Scratch const scratch;
    makeFolder(scratch / "a");
    put(scratch / "a/b", "1234567");
    put(scratch / "a\\b", "12345");
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch.path()), true), 7 + 7);
}

TEST(FileSizeVisitorPosix, counts_nothing_but_files) {
    Scratch const scratch;
    put(scratch / "file", "12345");
    std::filesystem::create_symlink("file", scratch / "link");
    std::filesystem::create_directory_symlink(".", scratch / "self");
    std::filesystem::create_symlink("none", scratch / "broken");
    ASSERT_EQ(::mkfifo((scratch / "pipe").c_str(), 0600), 0);
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch.path()), true), 5);
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch.path()), false), 5);
}

TEST(FileSizeVisitorPosix, needs_no_more_descriptors_than_the_listings_of_a_walk) {
    constexpr int DEPTH = 30;
    Scratch const scratch;
    std::string folder = scratch.path();
    for (int i = 0; i < DEPTH; ++i) {
        put(folder + "/file", "x");
        folder += "/d";
        makeFolder(folder);
        put(folder + "/other", "y");
    }
    FewDescriptors const few(DEPTH + 2);
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch.path()), true), 2 * DEPTH);
}

TEST(FileSizeVisitorPosix, sums_a_folder_whose_path_is_nearly_too_long) {
    Scratch const scratch;
    std::string folder = scratch.path();
    while (folder.size() + 120 < PATH_MAX) {
        folder += "/" + std::string(100, 'd');
        makeFolder(folder);
    }
    put(folder + "/f", "12345");
    int const place = ::open(folder.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC);
    std::string const tooLong(200, 'n');
    int const file = ::openat(place, tooLong.c_str(), O_CREAT | O_WRONLY | O_CLOEXEC, 0600);
    EXPECT_EQ(::write(file, "xyz", 3), 3);
    ::close(file);
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch.path()), true), 5) << "the path of the other file is too long";
    ::unlinkat(place, tooLong.c_str(), 0);
    ::close(place);
}
