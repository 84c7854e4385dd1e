// What only Linux can show of listings.

#include "tests/host/xos_basics/directories/listing.h"

#include <gtest/gtest.h>

#include <sys/stat.h>
#include <unistd.h>

TEST(HostListingPosix, counts_links_and_special_entries_as_files) {
    Scratch const scratch;
    makeFolder(scratch / "d");
    put(scratch / "f", "");
    std::filesystem::create_symlink("d", scratch / "to-d");
    std::filesystem::create_symlink("f", scratch / "to-f");
    std::filesystem::create_symlink("nowhere", scratch / "dangling");
    ASSERT_EQ(::mkfifo((scratch / "pipe").c_str(), 0600), 0);
    EXPECT_EQ(listed(scratch.path(), nullptr, DIRECTORIES), Names{"d"});
    EXPECT_EQ(listed(scratch.path(), nullptr, FILES), (Names{"f", "to-d", "to-f", "dangling", "pipe"}));
    EXPECT_EQ(listed(scratch.path()).size(), 6U);
}

TEST(HostListingPosix, may_start_at_a_link_to_a_directory) {
    Scratch const scratch;
    makeFolder(scratch / "d");
    put(scratch / "d/f", "");
    std::filesystem::create_symlink("d", scratch / "to-d");
    EXPECT_EQ(listed(scratch / "to-d"), Names{"f"});
}

TEST(HostListingPosix, gives_names_of_any_bytes) {
    Scratch const scratch;
    Names const names{"\xff\xfe", "caf\xe9", "back\\slash", "new\nline", std::string(255, 'n'), "\xc3\xa9"};
    for (std::string const& name : names) { put(scratch / name, ""); }
    EXPECT_EQ(listed(scratch.path()), names);
    EXPECT_EQ(listed(scratch.path(), "caf?"), Names{"caf\xe9"});
    // both kinds of slash are one in a pattern
    EXPECT_EQ(listed(scratch.path(), "back/slash"), Names{"back\\slash"});
}

TEST(HostListingPosix, tells_kinds_without_asking_for_the_status_of_each_entry) {
    Scratch const scratch;
    makeFolder(scratch / "top/d");
    put(scratch / "top/f", "");
    std::filesystem::permissions(scratch.path(), std::filesystem::perms::all);
    // A directory that may be read but not searched gives names; the status of an entry is refused.
    ASSERT_EQ(::chmod((scratch / "top").c_str(), 0444), 0);
    bool const privileged = ::geteuid() == 0;
    if (privileged) { ASSERT_EQ(::seteuid(65534), 0); }
    struct stat status {};
    EXPECT_NE(::stat((scratch / "top/d").c_str(), &status), 0);
    Names const directories = listed(scratch / "top", nullptr, DIRECTORIES);
    Names const files = listed(scratch / "top", nullptr, FILES);
    if (privileged) { ASSERT_EQ(::seteuid(0), 0); }
    ASSERT_EQ(::chmod((scratch / "top").c_str(), 0755), 0);
    EXPECT_EQ(directories, Names{"d"});
    EXPECT_EQ(files, Names{"f"});
}
