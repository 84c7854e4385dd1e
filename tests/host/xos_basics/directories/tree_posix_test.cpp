// What only Linux can show of trees: links, permissions, special entries.

#include "basis/platform/xos_basics.h"
#include "tests/host/support/entry_posix.h"
#include "tests/host/support/status.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

int removeTree(std::string const& path, std::uint32_t flags = 0x600) { return xos_DirRemove(path.c_str(), flags); }

} // namespace

TEST(HostTreePosix, removes_links_and_never_follows_them) {
    Scratch const scratch;
    makeFolder(scratch / "outside");
    put(scratch / "outside/precious", "precious");
    makeFolder(scratch / "tree/d");
    std::filesystem::create_symlink(scratch / "outside", scratch / "tree/to-directory");
    std::filesystem::create_symlink(scratch / "outside/precious", scratch / "tree/d/to-file");
    std::filesystem::create_symlink("../..", scratch / "tree/d/up");
    EXPECT_EQ(removeTree(scratch / "tree"), 0);
    EXPECT_EQ(scratch.content(), (Names{"outside/", "outside/precious"}));
}

TEST(HostTreePosix, removes_a_link_itself_however_it_is_spelt) {
    Scratch const scratch;
    makeFolder(scratch / "outside");
    put(scratch / "outside/precious", "precious");
    for (char const* spelling : {"link", "link/", "link//", "link\\"}) {
        for (std::uint32_t flags : {0U, 0x600U}) {
            std::filesystem::create_symlink("outside", scratch / "link");
            EXPECT_EQ(removeTree(scratch / spelling, flags), 0) << spelling;
            EXPECT_EQ(scratch.content(), (Names{"outside/", "outside/precious"}));
        }
    }
}

TEST(HostTreePosix, removes_special_entries_and_directories_that_may_not_be_read) {
    Scratch const scratch;
    makeFolder(scratch / "tree/closed");
    ASSERT_EQ(::mkfifo((scratch / "tree/pipe").c_str(), 0600), 0);
    ASSERT_EQ(::chmod((scratch / "tree/closed").c_str(), 0), 0);
    EXPECT_EQ(removeTree(scratch / "tree"), 0);
    EXPECT_EQ(scratch.content(), Names{});
}

namespace {

/// Acts as an ordinary user, to whom a tree was given before.
class AsItsOwner {
public:
    explicit AsItsOwner(std::string const& tree) {
        if (!privileged_) return;
        for (auto const& entry : std::filesystem::recursive_directory_iterator(tree)) {
            EXPECT_EQ(::lchown(entry.path().c_str(), NOBODY, NOBODY), 0);
        }
        EXPECT_EQ(::seteuid(NOBODY), 0);
    }
    ~AsItsOwner() {
        int const error = errno;
        if (privileged_) { EXPECT_EQ(::seteuid(0), 0); }
        errno = error;
    }
    AsItsOwner(AsItsOwner const&) = delete;
    AsItsOwner& operator=(AsItsOwner const&) = delete;

private:
    static constexpr uid_t NOBODY = 65534;
    bool const privileged_ = ::geteuid() == 0;
};

} // namespace

TEST(HostTreePosix, removes_all_it_can_and_says_that_it_could_not_remove_the_rest) {
    Scratch const scratch;
    makeFolder(scratch / "tree/locked");
    makeFolder(scratch / "tree/open/more");
    put(scratch / "tree/locked/f", "");
    put(scratch / "tree/open/f", "");
    std::filesystem::permissions(scratch.path(), std::filesystem::perms::all);
    int result = 0;
    int error = 0;
    {
        AsItsOwner const owner(scratch.path());
        ::chmod((scratch / "tree/locked").c_str(), 0500);
        errno = 0;
        result = removeTree(scratch / "tree");
        error = errno;
    }
    EXPECT_NE(result, 0);
    EXPECT_EQ(error, EACCES);
    EXPECT_EQ(scratch.content(), (Names{"tree/", "tree/locked/", "tree/locked/f"}));
    ::chmod((scratch / "tree/locked").c_str(), 0700);
}

TEST(HostTreePosix, removes_an_empty_directory_that_cannot_be_read_and_says_why_a_full_one_stays) {
    Scratch const scratch;
    makeFolder(scratch / "empty/unreadable");
    makeFolder(scratch / "full/unreadable");
    put(scratch / "full/unreadable/f", "");
    std::filesystem::permissions(scratch.path(), std::filesystem::perms::all);
    {
        AsItsOwner const owner(scratch.path());
        for (char const* tree : {"empty/unreadable", "full/unreadable"}) ::chmod((scratch / tree).c_str(), 0);
        EXPECT_EQ(removeTree(scratch / "empty"), 0);
        errno = 0;
        EXPECT_NE(removeTree(scratch / "full"), 0);
        EXPECT_EQ(errno, EACCES) << "not that it is not empty";
        ::chmod((scratch / "full/unreadable").c_str(), 0700);
    }
    EXPECT_EQ(scratch.content(), (Names{"full/", "full/unreadable/", "full/unreadable/f"}));
}

TEST(HostTreePosix, refuses_the_root_and_the_current_directory) {
    EXPECT_NE(removeTree("/", 0x400), 0);
    EXPECT_NE(removeTree(".", 0x400), 0);
    EXPECT_NE(removeTree("..", 0x400), 0);
}

TEST(HostTreePosix, copies_links_and_special_entries_as_what_they_are) {
    Scratch const scratch;
    makeFolder(scratch / "outside");
    put(scratch / "outside/f", "f");
    makeFolder(scratch / "from");
    std::filesystem::create_symlink("../outside", scratch / "from/to-directory");
    std::filesystem::create_symlink("nowhere", scratch / "from/dangling");
    ASSERT_EQ(::mkfifo((scratch / "from/pipe").c_str(), 0640), 0);
    for (std::uint32_t flags : {0x000U, 0x200U, 0x201U}) {
        EXPECT_EQ(xos_DirCopy((scratch / "to").c_str(), (scratch / "from").c_str(), flags), 0);
        EXPECT_EQ(scratch.content("to"), (Names{"to-directory", "dangling", "pipe"}));
        EXPECT_EQ(linkTarget(scratch / "to/to-directory"), "../outside");
        EXPECT_EQ(linkTarget(scratch / "to/dangling"), "nowhere");
        EXPECT_EQ(kindOf(scratch / "to/pipe"), 0x1000U);
        EXPECT_EQ(removeTree(scratch / "to"), 0);
    }
    EXPECT_EQ(textOf(scratch / "outside/f"), "f");
}

TEST(HostTreePosix, copies_and_moves_a_link_given_in_place_of_a_directory) {
    Scratch const scratch;
    makeFolder(scratch / "d");
    put(scratch / "d/f", "f");
    std::filesystem::create_symlink("d", scratch / "link");
    EXPECT_EQ(xos_DirCopy((scratch / "copy").c_str(), (scratch / "link").c_str(), 0x200), 0);
    EXPECT_EQ(linkTarget(scratch / "copy"), "d");
    EXPECT_NE(xos_DirCopy((scratch / "copy").c_str(), (scratch / "link").c_str(), 0x200), 0);
    EXPECT_EQ(errno, EEXIST);
    std::filesystem::remove(scratch / "copy");
    std::filesystem::create_symlink("elsewhere", scratch / "copy");
    EXPECT_EQ(xos_DirCopy((scratch / "copy").c_str(), (scratch / "link").c_str(), 0x201), 0);
    EXPECT_EQ(linkTarget(scratch / "copy"), "d");
    EXPECT_EQ(xos_DirMove((scratch / "moved").c_str(), (scratch / "link/").c_str(), 0), 0);
    EXPECT_EQ(linkTarget(scratch / "moved"), "d");
    EXPECT_EQ(scratch.content(), (Names{"copy", "d/", "d/f", "moved"}));
}

TEST(HostTreePosix, merges_into_no_link_below_the_target) {
    Scratch const scratch;
    makeFolder(scratch / "from/d");
    put(scratch / "from/d/f", "new");
    put(scratch / "from/g", "new");
    makeFolder(scratch / "outside");
    put(scratch / "outside/g", "precious");
    makeFolder(scratch / "to");
    std::filesystem::create_symlink(scratch / "outside/g", scratch / "to/g");
    EXPECT_NE(xos_DirCopy((scratch / "to").c_str(), (scratch / "from").c_str(), 0x000), 0);
    EXPECT_EQ(xos_DirCopy((scratch / "to").c_str(), (scratch / "from").c_str(), 0x001), 0);
    EXPECT_EQ(kindOf(scratch / "to/g"), KIND_FILE);
    std::filesystem::create_symlink(scratch / "outside", scratch / "to/d");
    EXPECT_NE(xos_DirCopy((scratch / "to").c_str(), (scratch / "from").c_str(), 0x201), 0);
    EXPECT_EQ(scratch.content("outside"), Names{"g"});
    EXPECT_EQ(textOf(scratch / "outside/g"), "precious");
}

TEST(HostTreePosix, refuses_to_copy_into_itself_by_way_of_a_link) {
    Scratch const scratch;
    makeFolder(scratch / "from/d");
    std::filesystem::create_symlink("from/d", scratch / "way-in");
    EXPECT_NE(xos_DirCopy((scratch / "way-in/new").c_str(), (scratch / "from").c_str(), 0x200), 0);
    EXPECT_NE(xos_DirCopy((scratch / "way-in").c_str(), (scratch / "from").c_str(), 0x200), 0);
    EXPECT_EQ(scratch.content("from"), Names{"d/"});
}

TEST(HostTreePosix, copies_exactly_the_permissions_of_directories) {
    mode_t const before = ::umask(077);
    Scratch const scratch;
    makeFolder(scratch / "from/open");
    makeFolder(scratch / "from/closed/below");
    put(scratch / "from/closed/f", "f");
    ASSERT_EQ(::chmod((scratch / "from/open").c_str(), 0777), 0);
    ASSERT_EQ(::chmod((scratch / "from/closed").c_str(), 0555), 0);
    ASSERT_EQ(::chmod((scratch / "from").c_str(), 0711), 0);
    EXPECT_EQ(xos_DirCopy((scratch / "to").c_str(), (scratch / "from").c_str(), 0x200), 0);
    ::umask(before);
    EXPECT_EQ(permissionsOf(scratch / "to"), 0711U);
    EXPECT_EQ(permissionsOf(scratch / "to/open"), 0777U);
    EXPECT_EQ(permissionsOf(scratch / "to/closed"), 0555U);
    EXPECT_EQ(textOf(scratch / "to/closed/f"), "f");
}

TEST(HostTreePosix, moves_special_entries_but_no_files) {
    Scratch const scratch;
    ASSERT_EQ(::mkfifo((scratch / "pipe").c_str(), 0600), 0);
    EXPECT_EQ(xos_DirMove((scratch / "moved").c_str(), (scratch / "pipe").c_str(), 0), 0);
    EXPECT_EQ(kindOf(scratch / "moved"), 0x1000U);
    EXPECT_EQ(xos_DirCopy((scratch / "copied").c_str(), (scratch / "moved").c_str(), 0), 0);
    EXPECT_EQ(kindOf(scratch / "copied"), 0x1000U);
}
