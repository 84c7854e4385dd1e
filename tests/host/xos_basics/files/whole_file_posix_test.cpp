// What only Linux can show of whole files: links, permissions, names of any bytes, holes, other file systems.

#include "basis/platform/xos_basics.h"
#include "tests/host/support/entry_posix.h"
#include "tests/host/support/status.h"
#include "tests/host/xos_basics/files/failing_calls_posix.h"
#include "tests/support/scratch.h"
#include "tests/support/skip.h"
#include "tests/support/system_error.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

/// Makes what the current user makes carry fewer permissions than files ask for.
struct Umask {
    explicit Umask(mode_t mask) : before(::umask(mask)) {}
    ~Umask() { ::umask(before); }
    mode_t before;
};

} // namespace

TEST(HostFilePosix, copies_what_only_its_owner_may_read_into_what_nobody_else_may_read_meanwhile) {
    Umask const mask{0};
    for (std::size_t const size : {std::size_t{1}, std::size_t{200'000}}) {
        Scratch const scratch;
        put(scratch / "a", std::string(size, 's'));
        ASSERT_EQ(::chmod((scratch / "a").c_str(), 0600), 0);
        makeFolder(scratch / "d");
        ASSERT_EQ(xos_FileCopy((scratch / "d/b").c_str(), (scratch / "a").c_str(), 0), 0);
        ASSERT_EQ(xos_FileCopy((scratch / "d/b").c_str(), (scratch / "a").c_str(), 1), 0);
        permissionsBeforeChange = 0;
        ASSERT_EQ(xos_DirCopy((scratch / "e").c_str(), (scratch / "d").c_str(), 0x200), 0);
        EXPECT_EQ(permissionsOf(scratch / "e/b"), 0600u);
        EXPECT_NE(permissionsBeforeChange, 0u) << "the copy was looked at";
        EXPECT_EQ(permissionsBeforeChange & 077, 0u);
        permissionsBeforeChange = 0;
        ASSERT_EQ(xos_FileCopy((scratch / "d/b").c_str(), (scratch / "a").c_str(), 1), 0);
        EXPECT_EQ(permissionsBeforeChange, 0600u);
    }
}

TEST(HostFilePosix, copies_exactly_the_permissions_and_the_nanoseconds) {
    Umask const mask{077};
    for (mode_t mode : {0644U, 0600U, 0777U, 0400U, 0751U, 0U}) {
        Scratch const scratch;
        put(scratch / "a", "x");
        ASSERT_EQ(::chmod((scratch / "a").c_str(), mode), 0);
        struct timespec const times[2] = {{1'000'000'000, 1}, {1'234'567'890, 987'654'321}};
        ASSERT_EQ(::utimensat(AT_FDCWD, (scratch / "a").c_str(), times, 0), 0);
        if (::geteuid() != 0 && (mode & 0400) == 0) continue;
        EXPECT_EQ(xos_FileCopy((scratch / "b").c_str(), (scratch / "a").c_str(), 0), 0);
        EXPECT_EQ(permissionsOf(scratch / "b"), mode);
        struct stat status {};
        ASSERT_EQ(::lstat((scratch / "b").c_str(), &status), 0);
        EXPECT_EQ(status.st_mtim.tv_sec, 1'234'567'890);
        EXPECT_EQ(status.st_mtim.tv_nsec, 987'654'321);
    }
}

TEST(HostFilePosix, copies_what_a_link_leads_to_and_replaces_the_link_itself) {
    Scratch const scratch;
    put(scratch / "a", "content");
    put(scratch / "precious", "precious");
    std::filesystem::create_symlink("a", scratch / "to-a");
    std::filesystem::create_symlink("precious", scratch / "b");
    EXPECT_NE(xos_FileCopy((scratch / "b").c_str(), (scratch / "to-a").c_str(), 0), 0);
    EXPECT_EQ(xos_FileCopy((scratch / "b").c_str(), (scratch / "to-a").c_str(), 1), 0);
    EXPECT_EQ(kindOf(scratch / "b"), KIND_FILE);
    EXPECT_EQ(textOf(scratch / "b"), "content");
    EXPECT_EQ(textOf(scratch / "precious"), "precious");
}

TEST(HostFilePosix, counts_a_dangling_link_as_something_that_exists) {
    Scratch const scratch;
    put(scratch / "a", "content");
    std::filesystem::create_symlink("nowhere", scratch / "b");
    EXPECT_NE(xos_FileCopy((scratch / "b").c_str(), (scratch / "a").c_str(), 0), 0);
    EXPECT_NE(xos_FileMove((scratch / "b").c_str(), (scratch / "a").c_str(), 0), 0);
    EXPECT_EQ(linkTarget(scratch / "b"), "nowhere");
    EXPECT_EQ(scratch.content(), (Names{"a", "b"}));
    EXPECT_EQ(xos_FileMove((scratch / "b").c_str(), (scratch / "a").c_str(), 1), 0);
    EXPECT_EQ(scratch.content(), Names{"b"});
    EXPECT_EQ(textOf(scratch / "b"), "content");
}

TEST(HostFilePosix, moves_links_and_removes_them_without_touching_what_they_lead_to) {
    Scratch const scratch;
    put(scratch / "a", "content");
    makeFolder(scratch / "d");
    std::filesystem::create_symlink("a", scratch / "to-a");
    std::filesystem::create_symlink("d", scratch / "to-d");
    EXPECT_EQ(xos_FileMove((scratch / "moved").c_str(), (scratch / "to-d").c_str(), 0), 0);
    EXPECT_EQ(linkTarget(scratch / "moved"), "d");
    EXPECT_EQ(xos_FileRemove((scratch / "moved").c_str(), 0), 0);
    EXPECT_EQ(xos_FileRemove((scratch / "to-a").c_str(), 0), 0);
    EXPECT_EQ(scratch.content(), (Names{"a", "d/"}));
}

TEST(HostFilePosix, tells_links_themselves) {
    Scratch const scratch;
    put(scratch / "a", "content");
    makeFolder(scratch / "d");
    std::filesystem::create_symlink("a", scratch / "to-a");
    std::filesystem::create_symlink("d", scratch / "to-d");
    std::filesystem::create_symlink("nowhere", scratch / "dangling");
    for (char const* name : {"to-a", "to-d", "dangling", "to-d/"}) {
        EXPECT_EQ(kindOf(scratch / name), KIND_LINK) << name;
    }
}

TEST(HostFilePosix, moves_one_of_two_names_of_a_file_onto_the_other) {
    Scratch const scratch;
    put(scratch / "a", "content");
    ASSERT_EQ(xos_FileHardLink((scratch / "a").c_str(), (scratch / "b").c_str()), 0);
    EXPECT_EQ(xos_FileMove((scratch / "b").c_str(), (scratch / "a").c_str(), 1), 0);
    EXPECT_EQ(scratch.content(), Names{"b"});
    EXPECT_EQ(textOf(scratch / "b"), "content");
    // the same name in two spellings is no second name
    EXPECT_EQ(xos_FileMove((scratch / "b").c_str(), (scratch / "./b").c_str(), 1), 0);
    EXPECT_EQ(textOf(scratch / "b"), "content");
}

TEST(HostFilePosix, replaces_neither_pipes_nor_devices_and_copies_none) {
    Scratch const scratch;
    put(scratch / "a", "content");
    ASSERT_EQ(::mkfifo((scratch / "pipe").c_str(), 0600), 0);
    EXPECT_NE(xos_FileCopy((scratch / "pipe").c_str(), (scratch / "a").c_str(), 1), 0);
    EXPECT_NE(xos_FileMove((scratch / "pipe").c_str(), (scratch / "a").c_str(), 1), 0);
    EXPECT_NE(xos_FileCopy((scratch / "b").c_str(), (scratch / "pipe").c_str(), 1), 0);
    EXPECT_NE(xos_FileCopy((scratch / "b").c_str(), "/dev/zero", 1), 0);
    EXPECT_EQ(kindOf(scratch / "pipe"), 0x1000U);
    EXPECT_EQ(scratch.content(), (Names{"a", "pipe"}));
}

TEST(HostFilePosix, copies_files_that_do_not_tell_their_size) {
    Scratch const scratch;
    EXPECT_EQ(xos_FileCopy((scratch / "b").c_str(), "/proc/version", 0), 0);
    EXPECT_EQ(textOf(scratch / "b"), textOf("/proc/version"));
    EXPECT_NE(textOf(scratch / "b"), "");
}

TEST(HostFilePosix, copies_a_file_of_holes_without_filling_them) {
    Scratch const scratch;
    off_t const size = (off_t{5} << 30) + 123;
    {
        int const file = ::open((scratch / "a").c_str(), O_WRONLY | O_CREAT, 0600);
        ASSERT_GE(file, 0);
        ASSERT_EQ(::ftruncate(file, size), 0);
        ASSERT_EQ(::pwrite(file, "begin", 5, 0), 5);
        ASSERT_EQ(::pwrite(file, "middle", 6, off_t{4} << 30), 6);
        ASSERT_EQ(::close(file), 0);
    }
    EXPECT_EQ(xos_FileCopy((scratch / "b").c_str(), (scratch / "a").c_str(), 0), 0);
    struct stat status {};
    ASSERT_EQ(::stat((scratch / "b").c_str(), &status), 0);
    EXPECT_EQ(status.st_size, size);
    EXPECT_LT(status.st_blocks, 4096);
    int const copy = ::open((scratch / "b").c_str(), O_RDONLY);
    char text[8] = {};
    EXPECT_EQ(::pread(copy, text, 5, 0), 5);
    EXPECT_STREQ(text, "begin");
    EXPECT_EQ(::pread(copy, text, 6, off_t{4} << 30), 6);
    EXPECT_STREQ(text, "middle");
    EXPECT_EQ(::pread(copy, text, 8, size - 8), 8);
    EXPECT_EQ(std::string(text, 8), std::string(8, '\0'));
    ::close(copy);
}

TEST(HostFilePosix, moves_nothing_to_another_file_system_but_copies_there) {
    struct stat here {};
    struct stat there {};
    Scratch const scratch;
    ASSERT_EQ(::stat(scratch.path().c_str(), &here), 0);
    if (::stat("/dev/shm", &there) != 0 || here.st_dev == there.st_dev || ::access("/dev/shm", W_OK) != 0) {
        CASE_CANNOT_HOLD("needs a second writable file system at /dev/shm");
    }
    Scratch const other{"/dev/shm"};
    put(scratch / "a", std::string(300'000, 'x'));
    makeFolder(scratch / "d");
    for (int overwrite : {0, 1}) {
        clearSystemError();
        EXPECT_NE(xos_FileMove((other / "a").c_str(), (scratch / "a").c_str(), overwrite), 0);
        EXPECT_EQ(systemError(), EXDEV);
        EXPECT_NE(xos_DirMove((other / "d").c_str(), (scratch / "d").c_str(), static_cast<unsigned>(overwrite)), 0);
        EXPECT_EQ(other.content(), Names{});
    }
    EXPECT_NE(xos_FileHardLink((scratch / "a").c_str(), (other / "a").c_str()), 0);
    EXPECT_EQ(xos_FileCopy((other / "a").c_str(), (scratch / "a").c_str(), 0), 0);
    EXPECT_EQ(textOf(other / "a"), std::string(300'000, 'x'));
    // what is in the way of a move that cannot follow stays
    makeFolder(other / "d");
    put(other / "d/f", "f");
    EXPECT_NE(xos_DirMove((other / "d").c_str(), (scratch / "d").c_str(), 1), 0);
    EXPECT_EQ(other.content(), (Names{"a", "d/", "d/f"}));
}

TEST(HostFilePosix, takes_names_of_any_bytes_and_of_255_of_them) {
    for (std::string const& name : {std::string{"\xff\xfe\x80"}, std::string{"caf\xe9"}, std::string{"tab\tline\n"},
                                    std::string(255, 'n'), std::string(255, '\xe9')}) {
        Scratch const scratch;
        put(scratch / "a", "a");
        EXPECT_EQ(xos_FileCopy((scratch / name).c_str(), (scratch / "a").c_str(), 0), 0);
        EXPECT_EQ(xos_FileCopy((scratch / name).c_str(), (scratch / "a").c_str(), 1), 0);
        xos_Dir const listing = xos_DirOpenEx(scratch.path().c_str(), "?*[!a]", 0);
        xos_DirClose(listing);
        EXPECT_EQ(scratch.content(), (Names{"a", name}));
        EXPECT_EQ(xos_FileMove((scratch / "a").c_str(), (scratch / name).c_str(), 1), 0);
        EXPECT_EQ(scratch.content(), Names{"a"});
    }
}

TEST(HostFilePosix, leaves_no_descriptor_open) {
    auto const count = [] {
        auto const files = std::filesystem::directory_iterator{"/proc/self/fd"};
        return std::distance(begin(files), end(files));
    };
    Scratch const scratch;
    put(scratch / "a", "a");
    makeFolder(scratch / "d/e");
    auto const before = count();
    for (int round = 0; round < 3; ++round) {
        xos_FileCopy((scratch / "b").c_str(), (scratch / "a").c_str(), 1);
        xos_FileCopy((scratch / "d").c_str(), (scratch / "a").c_str(), 1);
        xos_FileCopy((scratch / "c").c_str(), (scratch / "missing").c_str(), 1);
        xos_FileMove((scratch / "a").c_str(), (scratch / "b").c_str(), 1);
        xos_DirCopy((scratch / "copy").c_str(), (scratch / "d").c_str(), 0x201);
        xos_DirCopy((scratch / "d/e/f").c_str(), (scratch / "d").c_str(), 0x201);
        xos_DirMove((scratch / "moved").c_str(), (scratch / "copy").c_str(), 1);
        xos_DirRemove((scratch / "moved").c_str(), 0x200);
        xos_DirRemove((scratch / "missing").c_str(), 0x200);
        EXPECT_EQ(xos_FileOpen(scratch.path().c_str(), 2), 0U);
        EXPECT_EQ(xos_DirOpenEx((scratch / "a").c_str(), nullptr, 0), 0U);
    }
    EXPECT_EQ(count(), before);
}

TEST(HostFilePosix, hands_no_descriptor_to_child_processes) {
    Scratch const scratch;
    xos_File const file = xos_FileOpen((scratch / "f").c_str(), 0x16);
    std::string found = "none";
    for (auto const& entry : std::filesystem::directory_iterator{"/proc/self/fd"}) {
        std::error_code ignored;
        if (std::filesystem::read_symlink(entry.path(), ignored).string() != scratch / "f") continue;
        found = ::fcntl(std::stoi(entry.path().filename().string()), F_GETFD) == FD_CLOEXEC ? "closed" : "inherited";
    }
    EXPECT_EQ(found, "closed");
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
}
