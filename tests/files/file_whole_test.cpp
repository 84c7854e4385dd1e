// Operations on whole files.

#include <zor_basis/files/file.h>

#include "tests/support/table.h"

#include "tests/files/opened_file.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileWhole : CallsOfFiles {};

} // namespace

TEST_F(FileWhole, make_a_new_file_with_its_folders) {
    EXPECT_TRUE(File::New(at("f").c_str(), false));
    EXPECT_EQ(last("xos_FileOpen"), "\"f\", 0x54");
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_DirCreateEx"), 0u);
    EXPECT_FALSE(File::New(at("a/b/f").c_str(), false));
    EXPECT_FALSE(exists(at("a")));
    EXPECT_TRUE(File::New(at("a/b/f").c_str(), true));
    EXPECT_EQ(scratch.content(), (Names{"a/", "a/b/", "a/b/f", "f"}));
}

TEST_F(FileWhole, make_no_new_file_where_something_is) {
    put(at("f"), "text");
    makeFolder(at("d"));
    EXPECT_TRUE(File::New(at("f").c_str(), false));
    EXPECT_TRUE(File::New(at("f").c_str(), true));
    EXPECT_FALSE(File::New(at("d").c_str(), false));
    EXPECT_FALSE(File::New(at("d").c_str(), true));
    EXPECT_EQ(textOf(at("f")), "text");
    EXPECT_EQ(xos_HostCalls("xos_FileOpen"), 0u);
    EXPECT_FALSE(File::New("zb-bare-name", true)) << "it has no directory that could be made";
    EXPECT_FALSE(exists("zb-bare-name"));
    EXPECT_FALSE(File::New(nullptr, true));
}

TEST_F(FileWhole, make_no_new_file_where_the_platform_fails) {
    xos_HostFail("xos_FileOpen", 0, 1);
    EXPECT_FALSE(File::New(at("f").c_str(), false));
    EXPECT_EQ(xos_HostCalls("xos_FileCloseEx"), 0u);
    xos_HostFail("xos_DirCreateEx", 0, 9);
    EXPECT_FALSE(File::New(at("a/f").c_str(), true));
    EXPECT_EQ(scratch.content(), Names{});
    xos_HostFail("xos_FileCloseEx", 0, 1);
    EXPECT_TRUE(File::New(at("f").c_str(), false)) << "the file is there, and that counts";
}

TEST_F(FileWhole, remove_with_the_flags_of_their_arguments) {
    struct Case {
        Row row;
        bool flagA;
        bool flagB;
        char const* flags;
    };
    for (Case const& c : {
             Case{{}, false, false, "0x0"},
             Case{{}, true, false, "0x400"},
             Case{{}, false, true, "0x800"},
             Case{{}, true, true, "0xc00"},
         }) {
        SCOPED_TRACE(c.row);
        put(at("f"), "");
        EXPECT_TRUE(File::Rem(at("f").c_str(), c.flagA, c.flagB));
        EXPECT_EQ(last("xos_FileRemove"), std::string("\"f\", ") + c.flags);
        EXPECT_FALSE(exists(at("f")));
        EXPECT_FALSE(File::Rem(at("f").c_str(), c.flagA, c.flagB));
    }
}

TEST_F(FileWhole, copy_with_one_call) {
    put(at("f"), "text");
    EXPECT_TRUE(File::Copy(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(last("xos_FileCopy"), "\"g\", \"f\", 0");
    EXPECT_FALSE(File::Copy(at("g").c_str(), at("f").c_str(), false, false));
    put(at("f"), "more");
    EXPECT_TRUE(File::Copy(at("g").c_str(), at("f").c_str(), true, false));
    EXPECT_EQ(last("xos_FileCopy"), "\"g\", \"f\", 1");
    EXPECT_EQ(textOf(at("g")), "more");
    EXPECT_FALSE(File::Copy(at("a/b/g").c_str(), at("f").c_str(), true, false));
    EXPECT_TRUE(File::Copy(at("a/b/g").c_str(), at("f").c_str(), true, true));
    EXPECT_EQ(textOf(at("a/b/g")), "more");
    std::uint64_t const copies = xos_HostCalls("xos_FileCopy");
    EXPECT_FALSE(File::Copy("zb-bare", at("f").c_str(), true, true));
    xos_HostFail("xos_DirCreateEx", 0, 9);
    EXPECT_FALSE(File::Copy(at("c/d/g").c_str(), at("f").c_str(), true, true));
    EXPECT_EQ(xos_HostCalls("xos_FileCopy"), copies) << "no directory, no copy";
}

TEST_F(FileWhole, leave_read_only_files_as_the_platform_does) {
    put(at("f"), "text");
    std::filesystem::permissions(at("f"),
                                 std::filesystem::perms::owner_write | std::filesystem::perms::group_write |
                                     std::filesystem::perms::others_write,
                                 std::filesystem::perm_options::remove);
    EXPECT_TRUE(File::New(at("f").c_str(), false));
    EXPECT_TRUE(File::Copy(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(textOf(at("g")), "text");
    EXPECT_TRUE(File::Move(at("h").c_str(), at("g").c_str(), false, false));
    EXPECT_TRUE(File::Rem(at("h").c_str(), true, false));
    EXPECT_TRUE(File::Rem(at("f").c_str(), true, false));
    EXPECT_EQ(scratch.content(), Names{});
}
