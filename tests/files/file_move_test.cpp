// Moving files, and linking them where that can be done.

#include <zor_basis/files/file.h>

#include <zor_basis/files/dir.h>

#include "tests/files/opened_file.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileMove : CallsOfFiles {};

} // namespace

TEST_F(FileMove, move_by_the_platform_if_that_can) {
    put(at("f"), "text");
    EXPECT_TRUE(File::Move(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(last("xos_FileMove"), "\"g\", \"f\", 0");
    EXPECT_TRUE(File::Move(at("a/b/g").c_str(), at("g").c_str(), true, true));
    EXPECT_EQ(last("xos_FileMove"), "\"a/b/g\", \"g\", 1");
    EXPECT_EQ(scratch.content(), (Names{"a/", "a/b/", "a/b/g"}));
    EXPECT_EQ(xos_HostCalls("xos_FileCopy"), 0u);
    EXPECT_EQ(xos_HostCalls("xos_FileRemove"), 0u);
}

TEST_F(FileMove, move_by_copying_where_the_platform_cannot_move) {
    for (bool overwrite : {false, true}) {
        put(at("f"), "text");
        xos_HostFail("xos_FileMove", 0, 1);
        EXPECT_TRUE(File::Move(at("a/g").c_str(), at("f").c_str(), overwrite, true));
        EXPECT_EQ(last("xos_FileCopy"), std::string("\"a/g\", \"f\", ") + (overwrite ? "1" : "0"));
        EXPECT_EQ(last("xos_FileRemove"), "\"f\", 0x400");
        EXPECT_EQ(scratch.content(), (Names{"a/", "a/g"}));
        EXPECT_TRUE(File::Rem(at("a/g").c_str(), true, false));
        EXPECT_TRUE(Dir::Rem(at("a").c_str(), false, false));
    }
}

TEST_F(FileMove, move_nothing_when_the_first_directories_cannot_be_made) {
    put(at("f"), "text");
    xos_HostFail("xos_DirCreateEx", 0, 9);
    EXPECT_FALSE(File::Move(at("a/g").c_str(), at("f").c_str(), true, true));
    EXPECT_EQ(scratch.content(), Names{"f"});
    EXPECT_EQ(xos_HostCalls("xos_FileMove"), 0u);
    EXPECT_FALSE(File::Move("zb-bare", at("f").c_str(), true, true));
    EXPECT_EQ(scratch.content(), Names{"f"});
}

TEST_F(FileMove, count_as_moved_although_the_source_could_not_be_removed) {
    put(at("f"), "text");
    xos_HostFail("xos_FileMove", 0, 1);
    xos_HostFail("xos_FileRemove", 0, 1);
    EXPECT_TRUE(File::Move(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(scratch.content(), (Names{"f", "g"}));
}

TEST_F(FileMove, Kept_file_04_lose_the_source_when_neither_moving_nor_copying_works) {
    put(at("f"), "text");
    xos_HostFail("xos_FileMove", 0, 1);
    xos_HostFail("xos_FileCopy", 0, 1);
    EXPECT_FALSE(File::Move(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(scratch.content(), Names{});
    // The directories vanish between the two attempts to make them.
    put(at("f"), "text");
    static std::string folder;
    static int looks;
    folder = at("d");
    looks = 0;
    systemCalls.status = [](char const* path, xos_Stat& record) {
        record.st_mode_ = MODE_DIRECTORY;
        return folder == path && ++looks == 1;
    };
    xos_HostFail("xos_DirCreateEx", 0, 99);
    xos_HostFail("xos_FileStatByNameEx", 0, 99);
    xos_HostCallsReset();
    EXPECT_FALSE(File::Move(at("d/g").c_str(), at("f").c_str(), true, true));
    EXPECT_EQ(xos_HostCalls("xos_FileMove"), 1u);
    EXPECT_EQ(xos_HostCalls("xos_FileCopy"), 0u);
    EXPECT_EQ(last("xos_FileRemove"), "\"f\", 0x400");
    EXPECT_EQ(scratch.content(), Names{});
}

TEST_F(FileMove, link_or_copy) {
    put(at("f"), "text");
    EXPECT_TRUE(File::LinkOrCopy(at("g").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(last("xos_FileHardLink"), "\"f\", \"g\"");
    EXPECT_EQ(xos_HostCalls("xos_FileCopy"), 0u);
    put(at("f"), "both");
    EXPECT_EQ(textOf(at("g")), "both");

    xos_HostFail("xos_FileHardLink", 0, 1);
    EXPECT_TRUE(File::LinkOrCopy(at("h").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(last("xos_FileCopy"), "\"h\", \"f\", 1");
    xos_HostFail("xos_FileHardLink", 0, 1);
    xos_HostFail("xos_FileCopy", 0, 1);
    EXPECT_FALSE(File::LinkOrCopy(at("i").c_str(), at("f").c_str(), false, false));
    EXPECT_EQ(scratch.content(), (Names{"f", "g", "h"}));
}

TEST_F(FileMove, link_or_copy_onto_something_only_when_told) {
    put(at("f"), "text");
    put(at("g"), "old");
    makeFolder(at("d/e"));
    put(at("d/e/x"), "");
    EXPECT_FALSE(File::LinkOrCopy(at("g").c_str(), at("f").c_str(), false, true));
    EXPECT_FALSE(File::LinkOrCopy(at("d").c_str(), at("f").c_str(), false, true));
    EXPECT_EQ(textOf(at("g")), "old");
    EXPECT_TRUE(File::LinkOrCopy(at("g").c_str(), at("f").c_str(), true, false));
    EXPECT_EQ(last("xos_FileRemove"), "\"g\", 0x400");
    EXPECT_TRUE(File::LinkOrCopy(at("d").c_str(), at("f").c_str(), true, false));
    EXPECT_EQ(last("xos_DirRemove"), "\"d\", 0x600");
    EXPECT_EQ(scratch.content(), (Names{"d", "f", "g"}));
    EXPECT_EQ(textOf(at("d")), "text");

    xos_HostFail("xos_FileRemove", 0, 1);
    EXPECT_FALSE(File::LinkOrCopy(at("g").c_str(), at("f").c_str(), true, false));
    makeFolder(at("k"));
    xos_HostFail("xos_DirRemove", 0, 1);
    EXPECT_FALSE(File::LinkOrCopy(at("k").c_str(), at("f").c_str(), true, false));
    EXPECT_TRUE(exists(at("k")));
}

TEST_F(FileMove, link_or_copy_with_the_folders_where_nothing_is) {
    put(at("f"), "text");
    EXPECT_FALSE(File::LinkOrCopy(at("a/b/g").c_str(), at("f").c_str(), true, false));
    EXPECT_TRUE(File::LinkOrCopy(at("a/b/g").c_str(), at("f").c_str(), false, true));
    EXPECT_EQ(textOf(at("a/b/g")), "text");
    xos_HostFail("xos_DirCreateEx", 0, 9);
    std::uint64_t const links = xos_HostCalls("xos_FileHardLink");
    EXPECT_FALSE(File::LinkOrCopy(at("c/d/g").c_str(), at("f").c_str(), false, true));
    EXPECT_EQ(xos_HostCalls("xos_FileHardLink"), links);
}
