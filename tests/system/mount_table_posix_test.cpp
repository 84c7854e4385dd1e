// Local disks and shares on Linux, by a mount table of the tests' own.

#include <zor_basis/system.h>

#include "basis/system/mount_table_posix.h"
#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "tests/system/query_calls_test_posix.h"

#include <unistd.h>

#include <filesystem>

using namespace ZOR_Basis;
namespace fs = std::filesystem;

namespace {

struct MountTablePosix : QueryCallsTest {
    MountTablePosix() { use(TABLE); }

    void use(std::string const& table) {
        put(file, table);
        queryCalls.mountTable = file.c_str();
    }

    static constexpr char TABLE[] = R"(
# of the tests
rootfs / rootfs rw 0 0
/dev/sda1 / ext4 rw 0 0
proc /proc proc rw 0 0
tmpfs /zb/ram tmpfs rw 0 0
/dev/sr0 /zb/disc iso9660 ro 0 0
//srv/jobs /zb/jobs cifs rw 0 0
//srv/jobs/archive /zb/jobs/archive smb3 rw 0 0
/dev/sdb1 /zb/jobs/local xfs rw 0 0
filer:/export/spool /zb/spool nfs4 rw 0 0
[fd00::1]:/export /zb/six nfs rw 0 0
filer:/ /zb/all nfs rw 0 0
oddity /zb/odd nfs rw 0 0
\134\134srv\134back /zb/back cifs rw 0 0
//srv/with\040blank /zb/with\040blank cifs rw 0 0
me@host:/home /zb/ssh fuse.sshfs rw 0 0
/dev/sdc1 /zb/over ext4 rw 0 0
//srv/over /zb/over cifs rw 0 0
unknown /zb/unknown newfs rw 0 0
short line
)";

    Scratch const scratch;
    std::string const file = scratch / "mounts";
};

} // namespace

TEST_F(MountTablePosix, tell_local_disks) {
    struct Case {
        Row row;
        char const* path;
        bool local;
    };
    for (Case const& c : {
             Case{{}, "/", true},
             Case{{}, "/zb", true},
             Case{{}, "/zb/x/y", true},
             Case{{}, "/zb/ram", true},
             Case{{}, "/zb/ram/x", true},
             Case{{}, "/zb/ramp", true},
             Case{{}, "/zb/disc/x", true},
             Case{{}, "/zb/jobs", false},
             Case{{}, "/zb/jobs/x", false},
             Case{{}, "/zb/jobsx", true}, // another directory
             Case{{}, "/zb/jobs/local/x", true},
             Case{{}, "/zb/jobs/archive/x", false},
             Case{{}, "/zb/spool/x", false},
             Case{{}, "/zb/ssh/x", false},
             Case{{}, "/zb/unknown/x", false},
             Case{{}, "/zb/over/x", false}, // what was mounted last
             Case{{}, "/proc/self", false},
             Case{{}, "\\zb\\jobs\\x", false},
             Case{{}, "\\zb\\ram\\x", true},
             Case{{}, "no/such/path/here", true},
             Case{{}, "", false},
         }) {
        SCOPED_TRACE(c.row);
        EXPECT_EQ(Sys::isLocalDisk(c.path), c.local) << c.path;
    }
}

TEST_F(MountTablePosix, stand_for_their_shares) {
    struct Case {
        Row row;
        char const *path, *unc; // null: none
    };
    for (Case const& c : {
             Case{{}, "/zb/jobs", "//srv/jobs"},
             Case{{}, "/zb/jobs/", "//srv/jobs"},
             Case{{}, "/zb/jobs/a/b.pdf", "//srv/jobs/a/b.pdf"},
             Case{{}, "/zb/jobs///a", "//srv/jobs/a"},
             Case{{}, "\\zb\\jobs\\a", "//srv/jobs/a"},
             Case{{}, "/zb/jobs/archive/a", "//srv/jobs/archive/a"},
             Case{{}, "/zb/jobs/local/a", nullptr},
             Case{{}, "/zb/jobsx", nullptr},
             Case{{}, "/zb/spool/a", "//filer/export/spool/a"},
             Case{{}, "/zb/six/a", "//[fd00::1]/export/a"},
             Case{{}, "/zb/all/a", "//filer/a"},
             Case{{}, "/zb/odd/a", nullptr},
             Case{{}, "/zb/back/a", "//srv/back/a"},
             Case{{}, "/zb/with blank/a", "//srv/with blank/a"},
             Case{{}, "/zb/over/a", "//srv/over/a"},
             Case{{}, "/zb/ssh/a", nullptr},
             Case{{}, "/zb/ram/a", nullptr},
             Case{{}, "/", nullptr},
             Case{{}, "relative", nullptr},
             Case{{}, "", nullptr},
         }) {
        SCOPED_TRACE(c.row);
        char const* const expected = c.unc != nullptr ? c.unc : "before";
        bool const isShare = c.unc != nullptr;
        FPath unc("before");
        EXPECT_EQ(Sys::UnMap(c.path, unc), isShare);
        EXPECT_STREQ(unc.c_str(), expected);
        // Shares are mounted for everyone.
        unc = "before";
        EXPECT_EQ(Sys::UnMap(c.path, "jane", unc), isShare);
        EXPECT_STREQ(unc.c_str(), expected);
        unc = "before";
        EXPECT_EQ(Sys::UnMap(c.path, "jane", "secret", unc), isShare);
        EXPECT_STREQ(unc.c_str(), expected);
        unc = "before";
        EXPECT_EQ(Sys::UnMapLogin(c.path, unc), isShare);
        EXPECT_STREQ(unc.c_str(), expected);
    }
}

TEST_F(MountTablePosix, are_found_through_links_and_from_the_current_folder) {
    std::string const place = fs::canonical(scratch.path()).string();
    use("/dev/a / ext4 rw 0 0\n//srv/jobs " + place + "/jobs cifs rw 0 0\n");
    makeFolder(scratch / "jobs/deep");
    fs::create_directory_symlink(scratch / "jobs", scratch / "link");
    FPath unc;
    EXPECT_TRUE(Sys::UnMap((scratch / "link/deep/new/file").c_str(), unc));
    EXPECT_STREQ(unc.c_str(), "//srv/jobs/deep/new/file");
    EXPECT_TRUE(Sys::UnMap((scratch / "jobs/deep/../x").c_str(), unc));
    EXPECT_FALSE(Sys::isLocalDisk((scratch / "link").c_str()));
    EXPECT_TRUE(Sys::isLocalDisk(scratch.path().c_str()));
    fs::path const before = fs::current_path();
    fs::current_path(scratch / "jobs");
    EXPECT_TRUE(Sys::UnMap("deep/x", unc));
    EXPECT_STREQ(unc.c_str(), "//srv/jobs/deep/x");
    EXPECT_FALSE(Sys::isLocalDisk("."));
    fs::current_path(before);
}

TEST_F(MountTablePosix, are_found_through_links_to_the_root) {
    fs::create_directory_symlink("/", scratch / "top");
    FPath unc;
    EXPECT_TRUE(Sys::UnMap((scratch / "top/zb/jobs/x").c_str(), unc));
    EXPECT_STREQ(unc.c_str(), "//srv/jobs/x");
    EXPECT_TRUE(Sys::isLocalDisk((scratch / "top").c_str()));
}

TEST_F(MountTablePosix, may_be_unknown) {
    FPath unc("before");
    queryCalls.mountTable = "/no/such/table";
    EXPECT_FALSE(Sys::isLocalDisk("/"));
    EXPECT_FALSE(Sys::UnMap("/zb/jobs/x", unc));
    use("");
    EXPECT_FALSE(Sys::isLocalDisk("/"));
    use("//srv/jobs /zb/jobs cifs rw 0 0\n");
    EXPECT_FALSE(Sys::isLocalDisk("/elsewhere"));
    EXPECT_TRUE(Sys::UnMap("/zb/jobs/x", unc));
}

TEST_F(MountTablePosix, may_have_long_lines) {
    std::string const options(20'000, 'o');
    use("overlay / overlay rw,lowerdir=" + options + " 0 0\n//srv/jobs /zb/jobs cifs rw," + options + " 0 0\n" +
        "//srv/last /zb/last cifs rw 0 0\n");
    FPath unc;
    EXPECT_TRUE(Sys::isLocalDisk("/x"));
    EXPECT_TRUE(Sys::UnMap("/zb/jobs/x", unc));
    EXPECT_STREQ(unc.c_str(), "//srv/jobs/x");
    EXPECT_TRUE(Sys::UnMap("/zb/last/x", unc));
    EXPECT_STREQ(unc.c_str(), "//srv/last/x");
}

TEST_F(MountTablePosix, of_this_machine_can_be_asked) {
    queryCalls = real;
    FPath unc;
    EXPECT_FALSE(Sys::isLocalDisk("/proc/self"));
    EXPECT_FALSE(Sys::UnMap("/proc/self", unc));
}

TEST_F(MountTablePosix, leave_no_file_open) {
    auto const open = [] { return std::distance(fs::directory_iterator("/proc/self/fd"), fs::directory_iterator()); };
    auto const before = open();
    for (int i = 0; i < 10'000; ++i) {
        FPath unc;
        ASSERT_TRUE(Sys::UnMap("/zb/jobs/x", unc));
    }
    EXPECT_EQ(open(), before);
}
