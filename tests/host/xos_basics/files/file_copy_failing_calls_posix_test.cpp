// What becomes of files when a system call fails in the middle: the call fails with the reason and changes nothing, or
// goes another way.

#include "tests/host/xos_basics/files/failing_calls_posix.h"

#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <map>
#include <unistd.h>

namespace {

constexpr int NEW = 0;
constexpr int OVER = 1;
constexpr bool SUCCEEDS = true;
constexpr bool FAILS = false;

struct Case {
    Row row;
    char const* source;
    /// What fails, and how often before it succeeds.
    char const* call;
    int error, skip;
    int overwrite;
    bool succeeds;
};

/// The tests ask for much text.
std::string quickTextOf(std::string const& path) {
    std::string text(std::filesystem::file_size(path), '\0');
    std::ifstream(path, std::ios::binary).read(text.data(), static_cast<std::streamsize>(text.size()));
    return text;
}

/// Paths with their content.
using Contents = std::map<std::string, std::string>;

/// A small, a large and a sparse file, a folder, and a file to replace.
struct HostFailingCallsPosix : testing::Test {
    HostFailingCallsPosix() {
        put(scratch / "small", "small");
        put(scratch / "large", std::string(70'000, 'l'));
        int const file = ::open((scratch / "sparse").c_str(), O_WRONLY | O_CREAT, 0600);
        EXPECT_EQ(::pwrite(file, "data", 4, 1 << 17), 4);
        EXPECT_EQ(::ftruncate(file, 3 << 16), 0);
        ::close(file);
        makeFolder(scratch / "folder");
        put(scratch / "folder/inside", "inside");
        put(scratch / "old", "old");
    }
    std::string at(std::string const& name) const { return scratch / name; }
    Contents contents() const {
        Contents found;
        for (std::string const& name : scratch.content()) found[name] = name.back() == '/' ? "" : quickTextOf(at(name));
        return found;
    }

    template <class Call>
    void expectAll(std::initializer_list<Case> cases, Call const& call) const {
        for (Case const& c : cases) {
            SCOPED_TRACE(c.row);
            std::string const target = c.overwrite == OVER ? "old" : "new";
            Contents const before = contents();
            bool succeeded = false;
            int error = 0;
            {
                FailingCall const failing(c.call, c.error, c.skip);
                errno = 0;
                succeeded = call(at(target).c_str(), at(c.source).c_str(), c.overwrite) == 0;
                error = errno;
                EXPECT_TRUE(failing.hasFailed());
            }
            EXPECT_EQ(succeeded, c.succeeds);
            if (succeeded) {
                // Back to where it was.
                Contents after = contents();
                bool const wasMoved = after.count(c.source) == 0;
                std::string const name = before.count(c.source) != 0 ? target : target + "/";
                EXPECT_EQ(after[name], before.count(c.source) != 0 ? before.at(c.source) : "");
                if (wasMoved) {
                    std::filesystem::rename(at(target), at(c.source));
                } else {
                    std::filesystem::remove_all(at(target));
                }
                put(at("old"), "old");
            } else {
                EXPECT_EQ(error, c.error);
            }
            EXPECT_EQ(contents(), before);
        }
    }

    Scratch scratch;
};

} // namespace

TEST_F(HostFailingCallsPosix, copy_the_whole_file_or_nothing) {
    expectAll(
        {
            Case{{}, "small", "read", EINTR, 0, NEW, SUCCEEDS},
            Case{{}, "small", "read", EIO, 0, NEW, FAILS},
            Case{{}, "small", "read", EIO, 0, OVER, FAILS},
            Case{{}, "small", "write", EINTR, 0, NEW, SUCCEEDS},
            Case{{}, "small", "write", ENOSPC, 0, NEW, FAILS},
            Case{{}, "small", "write", ENOSPC, 0, OVER, FAILS},
            Case{{}, "small", "fchmod", EPERM, 0, NEW, SUCCEEDS},
            Case{{}, "small", "fchmod", EOPNOTSUPP, 0, NEW, SUCCEEDS},
            Case{{}, "small", "fchmod", EIO, 0, NEW, FAILS},
            Case{{}, "small", "futimens", EPERM, 0, NEW, SUCCEEDS},
            Case{{}, "small", "futimens", ENOSYS, 0, NEW, SUCCEEDS},
            Case{{}, "small", "futimens", EIO, 0, NEW, FAILS},
            Case{{}, "small", "renameat", EIO, 0, OVER, FAILS},
            Case{{}, "small", "renameat2", EIO, 0, NEW, FAILS},
            Case{{}, "small", "renameat2", ENOSYS, 0, NEW, SUCCEEDS},
            Case{{}, "small", "renameat2", EINVAL, 0, NEW, SUCCEEDS},
        },
        xos_FileCopy);
}

TEST_F(HostFailingCallsPosix, copy_by_reading_where_the_kernel_cannot_copy) {
    expectAll(
        {
            Case{{}, "large", "copy_file_range", EINTR, 0, NEW, SUCCEEDS},
            Case{{}, "large", "copy_file_range", EXDEV, 0, NEW, SUCCEEDS},
            Case{{}, "large", "copy_file_range", EINVAL, 0, NEW, SUCCEEDS},
            Case{{}, "large", "copy_file_range", ENOSYS, 0, NEW, SUCCEEDS},
            Case{{}, "large", "copy_file_range", EOPNOTSUPP, 0, NEW, SUCCEEDS},
            Case{{}, "large", "copy_file_range", EBADF, 0, NEW, SUCCEEDS},
            Case{{}, "large", "copy_file_range", EPERM, 0, NEW, SUCCEEDS},
            Case{{}, "large", "copy_file_range", ETXTBSY, 0, NEW, SUCCEEDS},
            Case{{}, "large", "copy_file_range", EIO, 0, NEW, FAILS},
            Case{{}, "large", "copy_file_range", ENOSPC, 0, OVER, FAILS},
        },
        xos_FileCopy);
}

TEST_F(HostFailingCallsPosix, copy_holes_or_nothing) {
    expectAll(
        {
            Case{{}, "sparse", "lseek", EINVAL, 0, NEW, SUCCEEDS}, // the file system knows no holes
            Case{{}, "sparse", "lseek", EIO, 0, NEW, FAILS},
            Case{{}, "sparse", "lseek", EIO, 1, NEW, FAILS},
            Case{{}, "sparse", "lseek", EIO, 2, NEW, FAILS},
            Case{{}, "sparse", "lseek", EIO, 3, NEW, FAILS},
            Case{{}, "sparse", "lseek", EIO, 4, NEW, FAILS},
            Case{{}, "sparse", "copy_file_range", EIO, 0, NEW, FAILS},
            Case{{}, "sparse", "copy_file_range", EXDEV, 0, NEW, SUCCEEDS},
            Case{{}, "sparse", "ftruncate", EIO, 0, NEW, FAILS},
        },
        xos_FileCopy);
}

TEST_F(HostFailingCallsPosix, move_files_and_folders_whole) {
    expectAll(
        {
            Case{{}, "small", "renameat2", EIO, 0, NEW, FAILS},
            Case{{}, "small", "renameat2", ENOSYS, 0, NEW, SUCCEEDS},
            Case{{}, "small", "renameat2", EINVAL, 0, NEW, SUCCEEDS},
        },
        xos_FileMove);
    expectAll(
        {
            Case{{}, "folder", "renameat2", EIO, 0, NEW, FAILS},
            Case{{}, "folder", "renameat2", ENOSYS, 0, NEW, SUCCEEDS},
        },
        [](char const* to, char const* from, int) { return xos_DirMove(to, from, 0); });
}

TEST_F(HostFailingCallsPosix, move_to_a_new_name_where_no_call_spares_an_existing_one) {
    FailingCall const noExclusiveRename("renameat2", ENOSYS, 0, 1000);
    auto const moveFolder = [](char const* to, char const* from, int) { return xos_DirMove(to, from, 0); };
    expectAll(
        {
            Case{{}, "small", "linkat", EPERM, 0, NEW, SUCCEEDS}, // the file system knows no links
            Case{{}, "small", "linkat", EMLINK, 0, NEW, SUCCEEDS},
            Case{{}, "small", "linkat", EOPNOTSUPP, 0, NEW, SUCCEEDS},
            Case{{}, "small", "linkat", EIO, 0, NEW, FAILS},
            Case{{}, "small", "unlinkat", EIO, 0, NEW, FAILS},
        },
        xos_FileMove);
    expectAll(
        {
            Case{{}, "folder", "mkdirat", EIO, 0, NEW, FAILS},
            Case{{}, "folder", "renameat", EIO, 0, NEW, FAILS},
        },
        moveFolder);
    FailingCall const noLinks("linkat", EPERM, 0, 1000);
    expectAll({Case{{}, "small", "renameat", EIO, 0, NEW, FAILS}}, xos_FileMove);
    Contents const before = contents();
    EXPECT_NE(xos_FileMove(at("old").c_str(), at("small").c_str(), 0), 0);
    EXPECT_EQ(errno, EEXIST);
    EXPECT_EQ(contents(), before);
}
