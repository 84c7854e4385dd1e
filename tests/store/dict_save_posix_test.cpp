// What Linux knows of a file besides its content: links, owners, permissions, and disks that run full.

#include "tests/store/dict_files.h"
#include "tests/support/scratch.h"
#include "tests/support/skip.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <gtest/gtest.h>

#include <cerrno>
#include <fcntl.h>
#include <grp.h>
#include <sys/mount.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <sys/xattr.h>
#include <unistd.h>

using namespace ZOR_Basis;

namespace {

constexpr uid_t NOBODY = 65534;
std::string const NEW = fileOf({{"a", "1"}});

struct DictSavePosix : testing::Test {
    DictSavePosix() { dict.set(blob("a"), blob("1")); }
    ~DictSavePosix() override { xos_HostFailClear(); }

    bool saveTo(std::string const& name) {
        dict.setPath(Str(scratch / name));
        return dict.save();
    }
    void link(std::string const& target, std::string const& name) const {
        ASSERT_EQ(::symlink(target.c_str(), (scratch / name).c_str()), 0);
    }
    std::string linkText(std::string const& name) const {
        return std::filesystem::read_symlink(scratch / name).generic_string();
    }
    struct stat status(std::string const& name) const {
        struct stat found {};
        EXPECT_EQ(::lstat((scratch / name).c_str(), &found), 0);
        return found;
    }
    /// Runs a step in a process of another user. \return its result; -1: it could not be run
    template <class Step>
    static int asNobody(Step step) {
        pid_t const child = ::fork();
        if (child == 0) {
            bool const changed = ::setgroups(0, nullptr) == 0 && ::setgid(NOBODY) == 0 && ::setuid(NOBODY) == 0;
            ::_exit(changed ? step() : 255);
        }
        int state = 0;
        ::waitpid(child, &state, 0);
        return WIFEXITED(state) && WEXITSTATUS(state) != 255 ? WEXITSTATUS(state) : -1;
    }

    Scratch scratch;
    BlobDict dict;
};

} // namespace

TEST_F(DictSavePosix, replaces_what_a_link_leads_to) {
    makeFolder(scratch / "far");
    struct Case {
        Row row;
        std::string text, file;
    };
    for (Case const& c : {
             Case{{}, "file", "file"},
             Case{{}, "far/file", "far/file"},
             Case{{}, "./far/../file", "file"},
             Case{{}, scratch / "far/file", "far/file"},
         }) {
        SCOPED_TRACE(c.row);
        for (bool there : {true, false}) {
            std::filesystem::remove(scratch / "link");
            std::filesystem::remove(scratch / c.file);
            if (there) put(scratch / c.file, "old");
            link(c.text, "link");
            EXPECT_TRUE(saveTo("link"));
            EXPECT_EQ(linkText("link"), c.text) << "the link stays";
            EXPECT_TRUE(S_ISREG(status(c.file).st_mode));
            EXPECT_EQ(textOf(scratch / c.file), NEW);
        }
    }
    link("link", "far/../to link");
    link("../to link", "far/to the other");
    EXPECT_TRUE(saveTo("far/to the other")) << "over two more";
    EXPECT_EQ(linkText("to link"), "link");
    EXPECT_EQ(scratch.content(), (Names{"far/", "far/file", "far/to the other", "file", "link", "to link"}));
}

TEST_F(DictSavePosix, follows_no_links_that_lead_nowhere) {
    link("b", "a");
    link("a", "b");
    EXPECT_FALSE(saveTo("a"));
    EXPECT_EQ(errno, ELOOP);
    EXPECT_EQ(linkText("a") + linkText("b"), "ba");
    std::filesystem::remove(scratch / "a");
    std::filesystem::remove(scratch / "b");
    link("no/folder", "c");
    EXPECT_FALSE(saveTo("c"));
    EXPECT_EQ(errno, ENOENT);
    EXPECT_EQ(scratch.content(), Names{"c"});
}

TEST_F(DictSavePosix, leaves_other_names_of_the_file_alone) {
    put(scratch / "file", "old");
    ASSERT_EQ(::link((scratch / "file").c_str(), (scratch / "other").c_str()), 0);
    EXPECT_TRUE(saveTo("file"));
    EXPECT_EQ(textOf(scratch / "file"), NEW);
    EXPECT_EQ(textOf(scratch / "other"), "old");
}

TEST_F(DictSavePosix, replaces_nothing_but_files) {
    ASSERT_EQ(::mkfifo((scratch / "pipe").c_str(), 0600), 0);
    link("/dev/null", "null");
    int const reader = ::open((scratch / "pipe").c_str(), O_RDONLY | O_NONBLOCK);
    for (char const* name : {"pipe", "null"}) {
        EXPECT_FALSE(saveTo(name)) << name;
        EXPECT_EQ(errno, EINVAL) << name;
    }
    ::close(reader);
    EXPECT_FALSE(saveTo("pipe")) << "without waiting for a reader";
    EXPECT_EQ(errno, ENXIO);
    EXPECT_EQ(scratch.content(), (Names{"null", "pipe"}));
}

TEST_F(DictSavePosix, keeps_permissions) {
    for (mode_t mode : {0600, 0640, 0644, 0666, 0777, 0604, 0200}) {
        put(scratch / "file", "old");
        ASSERT_EQ(::chmod((scratch / "file").c_str(), mode), 0);
        EXPECT_TRUE(saveTo("file"));
        EXPECT_EQ(status("file").st_mode & 07777, mode) << std::oct << mode;
        EXPECT_EQ(textOf(scratch / "file"), NEW);
    }
    for (mode_t mask : {0000, 0022, 0077}) {
        mode_t const before = ::umask(mask);
        std::filesystem::remove(scratch / "new");
        EXPECT_TRUE(saveTo("new"));
        ::umask(before);
        EXPECT_EQ(status("new").st_mode & 07777, 0666 & ~mask) << "as for every new file";
    }
}

TEST_F(DictSavePosix, keeps_the_owner_where_it_may) {
    if (::geteuid() != 0) CASE_CANNOT_HOLD("giving files away needs privilege");
    put(scratch / "file", "old");
    ASSERT_EQ(::chown((scratch / "file").c_str(), 1234, 5678), 0);
    ASSERT_EQ(::chmod((scratch / "file").c_str(), 0640), 0);
    EXPECT_TRUE(saveTo("file"));
    EXPECT_EQ(status("file").st_uid, 1234u);
    EXPECT_EQ(status("file").st_gid, 5678u);
    EXPECT_EQ(status("file").st_mode & 07777, 0640u);
}

TEST_F(DictSavePosix, gives_its_own_group_no_more_than_everyone_has) {
    if (::geteuid() != 0) CASE_CANNOT_HOLD("becoming another user needs privilege");
    ASSERT_EQ(::chmod(scratch.path().c_str(), 0777), 0);
    for (mode_t mode : {0666, 0662, 0676}) {
        put(scratch / "file", "old");
        ASSERT_EQ(::chown((scratch / "file").c_str(), 1234, 5678), 0);
        ASSERT_EQ(::chmod((scratch / "file").c_str(), mode), 0);
        EXPECT_EQ(asNobody([&] { return saveTo("file") ? 0 : errno; }), 0);
        EXPECT_EQ(textOf(scratch / "file"), NEW);
        EXPECT_EQ(status("file").st_uid, NOBODY);
        EXPECT_EQ(status("file").st_mode & 07777, (mode & 0707) | ((mode & 07) << 3 & mode)) << std::oct << mode;
        std::filesystem::remove(scratch / "file");
    }
}

TEST_F(DictSavePosix, does_not_replace_what_may_not_be_written) {
    if (::geteuid() != 0) CASE_CANNOT_HOLD("becoming another user needs privilege");
    ASSERT_EQ(::chmod(scratch.path().c_str(), 0777), 0);
    put(scratch / "file", "old");
    ASSERT_EQ(::chmod((scratch / "file").c_str(), 0644), 0);
    EXPECT_EQ(asNobody([&] { return saveTo("file") ? 0 : errno; }), EACCES);
    makeFolder(scratch / "folder");
    put(scratch / "folder/file", "old");
    ASSERT_EQ(::chmod((scratch / "folder/file").c_str(), 0666), 0);
    EXPECT_EQ(asNobody([&] { return saveTo("folder/file") ? 0 : errno; }), EACCES);
    EXPECT_EQ(asNobody([&] { return saveTo("folder/new") ? 0 : errno; }), EACCES);
    EXPECT_EQ(textOf(scratch / "file"), "old");
    EXPECT_EQ(textOf(scratch / "folder/file"), "old");
    EXPECT_EQ(scratch.content(), (Names{"file", "folder/", "folder/file"}));
}

TEST_F(DictSavePosix, keeps_the_list_of_further_users) {
    // Version 2, then tag, permission and number: the owner, the user 1234, the group, the mask, the others.
    std::string const list("\2\0\0\0"
                           "\1\0\6\0\xFF\xFF\xFF\xFF"
                           "\2\0\6\0\xD2\4\0\0"
                           "\4\0\4\0\xFF\xFF\xFF\xFF"
                           "\x10\0\6\0\xFF\xFF\xFF\xFF"
                           "\x20\0\0\0\xFF\xFF\xFF\xFF",
                           44);
    put(scratch / "file", "old");
    char const* const name = "system.posix_acl_access";
    if (::setxattr((scratch / "file").c_str(), name, list.data(), list.size(), 0) != 0) {
        CASE_CANNOT_HOLD("the file system keeps no such lists");
    }
    EXPECT_TRUE(saveTo("file"));
    char kept[100];
    ssize_t const n = ::getxattr((scratch / "file").c_str(), name, kept, sizeof kept);
    ASSERT_GT(n, 0);
    EXPECT_EQ(std::string(kept, static_cast<std::size_t>(n)), list);
    EXPECT_EQ(textOf(scratch / "file"), NEW);
}

TEST_F(DictSavePosix, takes_the_longest_names_there_are) {
    std::string const name(255, 'n');
    EXPECT_TRUE(saveTo(name));
    EXPECT_TRUE(saveTo(name));
    EXPECT_EQ(scratch.content(), Names{name});
    EXPECT_FALSE(saveTo(name + "n"));
    EXPECT_EQ(errno, ENAMETOOLONG);
}

TEST_F(DictSavePosix, leaves_the_old_file_on_a_disk_that_runs_full) {
    makeFolder(scratch / "disk");
    if (::mount("tmpfs", (scratch / "disk").c_str(), "tmpfs", 0, "size=1m") != 0) {
        CASE_CANNOT_HOLD("mounting a file system needs privilege");
    }
    Pairs const old = {{"old", std::string(300'000, 'o')}};
    put(scratch / "disk/dict", fileOf(old));
    dict.set(blob("large"), blob(std::string(900'000, 'L')));
    for (bool stuck : {false, true}) {
        if (stuck) xos_HostFail("xos_FileRemove", 0, 1);
        EXPECT_FALSE(saveTo("disk/dict"));
        EXPECT_EQ(errno, ENOSPC) << "the reason, and not that of the clean-up";
        EXPECT_EQ(textOf(scratch / "disk/dict"), fileOf(old));
        EXPECT_EQ(scratch.content("disk").size(), stuck ? 2u : 1u);
    }
    for (std::string const& name : scratch.content("disk")) {
        if (name != "dict") std::filesystem::remove(scratch / ("disk/" + name));
    }
    dict.set(blob("large"), blob(std::string(500'000, 'L')));
    EXPECT_TRUE(saveTo("disk/dict")) << "there is room for both files";
    BlobDict other{Str(scratch / "disk/dict")};
    EXPECT_EQ(other.size(), 2u);
    dict.set(blob("large"), blob(std::string(600'000, 'L')));
    EXPECT_FALSE(saveTo("disk/dict"));
    EXPECT_TRUE(dict.write()) << "which needs room for one, and gives up the old one first";
    EXPECT_EQ(::umount2((scratch / "disk").c_str(), MNT_DETACH), 0);
}
