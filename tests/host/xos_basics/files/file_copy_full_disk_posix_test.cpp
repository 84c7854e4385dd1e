// A disk that runs full, and one that cannot be written: nothing is lost, nothing half made stays.

#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"
#include "tests/support/skip.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <sys/mount.h>

namespace {

/// A file system of 1 MiB, where mounting is permitted.
class HostSmallDiskPosix : public testing::Test {
protected:
    void SetUp() override {
        makeFolder(path());
        if (::mount("tmpfs", path().c_str(), "tmpfs", 0, "size=1m") != 0) {
            CASE_CANNOT_HOLD("mounting a file system needs privilege");
        }
        mounted_ = true;
    }
    ~HostSmallDiskPosix() override {
        if (mounted_) ::umount2(path().c_str(), MNT_DETACH);
    }

    std::string path() const { return scratch / "disk"; }
    std::string operator/(std::string const& name) const { return path() + "/" + name; }
    Names content() const { return scratch.content("disk"); }
    void protect() const { ASSERT_EQ(::mount(nullptr, path().c_str(), nullptr, MS_REMOUNT | MS_RDONLY, nullptr), 0); }

    Scratch scratch;

private:
    bool mounted_ = false;
};

} // namespace

TEST_F(HostSmallDiskPosix, reports_how_much_of_a_write_it_took) {
    xos_File const file = xos_FileOpen((*this / "f").c_str(), 0x14);
    ASSERT_NE(file, 0U);
    std::string const text(3 << 20, 'x');
    std::uint64_t const written = xos_FileWriteEx(file, text.data(), text.size(), 0, 0);
    EXPECT_EQ(errno, ENOSPC);
    EXPECT_GT(written, 500'000U);
    EXPECT_LE(written, 1U << 20);
    EXPECT_EQ(xos_FileCloseEx(file, 0), 0);
    EXPECT_EQ(textOf(*this / "f"), text.substr(0, written));
}

TEST_F(HostSmallDiskPosix, holds_no_part_of_a_file_that_does_not_fit) {
    put(scratch / "large", std::string(3 << 20, 'x'));
    put(*this / "old", "old");
    for (int overwrite : {0, 1}) {
        EXPECT_NE(xos_FileCopy((*this / "new").c_str(), (scratch / "large").c_str(), overwrite), 0);
        EXPECT_EQ(errno, ENOSPC);
        EXPECT_EQ(content(), Names{"old"});
    }
    EXPECT_NE(xos_FileCopy((*this / "old").c_str(), (scratch / "large").c_str(), 1), 0);
    EXPECT_EQ(content(), Names{"old"});
    EXPECT_EQ(textOf(*this / "old"), "old");
}

TEST_F(HostSmallDiskPosix, holds_no_part_of_a_folder_that_does_not_fit) {
    for (char const* name : {"tree/a", "tree/b/c"}) {
        makeFolder(scratch / name);
        for (int i = 0; i < 20; ++i) {
            put(scratch / (std::string{name} + "/f" + std::to_string(i)), std::string(50'000, 'x'));
        }
    }
    EXPECT_NE(xos_DirCopy((*this / "tree").c_str(), (scratch / "tree").c_str(), 0x200), 0);
    EXPECT_EQ(errno, ENOSPC);
    EXPECT_EQ(content(), Names{});
    // into a folder that is there, whole files come or none
    makeFolder(*this / "tree");
    EXPECT_NE(xos_DirCopy((*this / "tree").c_str(), (scratch / "tree").c_str(), 0x200), 0);
    EXPECT_EQ(errno, ENOSPC);
    for (std::string const& name : content()) {
        if (name.back() != '/') { EXPECT_EQ(textOf(*this / name).size(), 50'000U) << name; }
        EXPECT_EQ(name.find(".xos-"), std::string::npos) << name;
    }
}

TEST_F(HostSmallDiskPosix, stays_as_it_is_when_it_cannot_be_written) {
    put(*this / "old", "old");
    makeFolder(*this / "d");
    put(scratch / "a", "a");
    makeFolder(scratch / "tree");
    protect();
    std::string const old = *this / "old";
    EXPECT_NE(xos_FileCopy((*this / "new").c_str(), (scratch / "a").c_str(), 0), 0);
    EXPECT_EQ(errno, EROFS);
    EXPECT_NE(xos_FileCopy(old.c_str(), (scratch / "a").c_str(), 1), 0);
    EXPECT_NE(xos_FileMove((*this / "new").c_str(), old.c_str(), 1), 0);
    EXPECT_NE(xos_FileRemove(old.c_str(), 0x400), 0);
    EXPECT_NE(xos_FileHardLink(old.c_str(), (*this / "new").c_str()), 0);
    EXPECT_EQ(xos_FileOpen(old.c_str(), 0x14), 0U);
    EXPECT_NE(xos_DirCreateEx((*this / "new").c_str(), 0), 0);
    EXPECT_EQ(errno, EROFS);
    EXPECT_NE(xos_DirCopy((*this / "new").c_str(), (scratch / "tree").c_str(), 0x200), 0);
    EXPECT_NE(xos_DirMove((*this / "new").c_str(), (*this / "d").c_str(), 1), 0);
    EXPECT_NE(xos_DirRemove((*this / "d").c_str(), 0x200), 0);
    EXPECT_EQ(errno, EROFS);
    EXPECT_EQ(content(), (Names{"d/", "old"}));
}
