#include "host/xos_basics/semaphores/run_file_posix.h"

#include "tests/host/support/entry_posix.h"
#include "tests/support/scratch.h"
#include "tests/support/skip.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <string>
#include <sys/mount.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

std::string const FOLDER = "xos-" + std::to_string(::geteuid());

/// Two parents, of which the first is the better one.
struct HostRunFilePosix : testing::Test {
    HostRunFilePosix() {
        makeFolder(first);
        makeFolder(second);
    }
    /// \return whether a file came to be open
    bool opens(char const* name) const {
        char const* const parents[] = {first.c_str(), second.c_str()};
        errno = 0;
        int const file = host::openRunFile(parents, name);
        if (file < 0) return false;
        EXPECT_EQ(::fcntl(file, F_GETFD), FD_CLOEXEC);
        ::close(file);
        return true;
    }

    Scratch scratch;
    std::string const first = scratch / "first";
    std::string const second = scratch / "second";
};

/// A folder that is mounted onto itself and then cannot be written, where mounting is permitted.
class ReadOnly {
public:
    explicit ReadOnly(std::string const& path) : path_(path) {
        char const* const at = path_.c_str();
        isBound_ = ::mount(at, at, nullptr, MS_BIND, nullptr) == 0;
        isReadOnly_ = isBound_ && ::mount(nullptr, at, nullptr, MS_REMOUNT | MS_BIND | MS_RDONLY, nullptr) == 0;
    }
    ~ReadOnly() {
        if (isBound_) ::umount2(path_.c_str(), MNT_DETACH);
    }
    ReadOnly(ReadOnly const&) = delete;
    ReadOnly& operator=(ReadOnly const&) = delete;
    explicit operator bool() const { return isReadOnly_; }

private:
    std::string path_;
    bool isBound_;
    bool isReadOnly_;
};

} // namespace

TEST_F(HostRunFilePosix, lies_in_the_first_parent_for_the_user_alone) {
    EXPECT_TRUE(opens("mutex-1"));
    EXPECT_TRUE(opens("mutex-1")) << "one that exists";
    EXPECT_EQ(permissionsOf(first + "/" + FOLDER), 0700u);
    EXPECT_EQ(permissionsOf(first + "/" + FOLDER + "/mutex-1"), 0600u);
    EXPECT_EQ(scratch.content("second"), Names{});
}

TEST_F(HostRunFilePosix, lies_in_the_next_parent_where_one_is_missing_or_not_trusted) {
    std::filesystem::remove(first);
    EXPECT_TRUE(opens("a"));
    makeFolder(first + "/" + FOLDER);
    ASSERT_EQ(::chmod((first + "/" + FOLDER).c_str(), 0770), 0);
    EXPECT_TRUE(opens("b")) << "a folder that others may write";
    std::filesystem::remove_all(first);
    makeFolder(first);
    std::filesystem::create_symlink(second, first + "/" + FOLDER);
    EXPECT_TRUE(opens("c")) << "a link";
    EXPECT_EQ(scratch.content("second/" + FOLDER), (Names{"a", "b", "c"}));
}

TEST_F(HostRunFilePosix, lies_in_the_next_parent_where_its_folder_exists_and_cannot_be_written) {
    ASSERT_TRUE(opens("before"));
    ReadOnly const readOnly(first);
    if (!readOnly) CASE_CANNOT_HOLD("mounting is not permitted");
    EXPECT_TRUE(opens("before")) << "for a lock, a file that can only be read is no use";
    EXPECT_TRUE(opens("after"));
    EXPECT_EQ(scratch.content("second/" + FOLDER), (Names{"after", "before"}));
}

TEST_F(HostRunFilePosix, lies_nowhere_else_for_a_process_that_lacks_descriptors) {
    ASSERT_TRUE(opens("a"));
    rlimit before{};
    ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &before), 0);
    rlimit none = before;
    none.rlim_cur = 0;
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &none), 0);
    EXPECT_FALSE(opens("a"));
    int const error = errno;
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &before), 0);
    EXPECT_EQ(error, EMFILE);
    EXPECT_EQ(scratch.content("second"), Names{});
}

TEST_F(HostRunFilePosix, says_why_it_lies_nowhere) {
    std::filesystem::remove(first);
    std::filesystem::remove(second);
    EXPECT_FALSE(opens("a"));
    EXPECT_EQ(errno, ENOENT);
    makeFolder(second + "/" + FOLDER);
    ASSERT_EQ(::chmod((second + "/" + FOLDER).c_str(), 0707), 0);
    EXPECT_FALSE(opens("a"));
    EXPECT_EQ(errno, EACCES);
}
