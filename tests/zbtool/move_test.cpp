#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

TEST(Move, renames_files_and_folders) {
    Tool tool;
    put(tool / "file", "text");
    makeFolder(tool / "folder/below");
    EXPECT_EQ(tool.run({"move", "file", "other"}), (ToolResult{0, "moved file to other\n", ""}));
    EXPECT_EQ(tool.run({"move", "folder", "new"}).code, 0);
    EXPECT_EQ(tool.run({"move", "other", "new"}).code, 0);
    EXPECT_EQ(tool.content(), (Names{"new/", "new/below/", "new/other"}));
}

// A refused move of the library removes the source all the same.
TEST(Move, keeps_both_when_the_target_exists) {
    Tool tool;
    put(tool / "file", "text");
    put(tool / "other", "older");
    makeFolder(tool / "spool/folder/x");
    makeFolder(tool / "folder/y");
    ToolResult const refused = tool.run({"move", "file", "other"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_TRUE(isOneLineAbout(refused.errors, "'other'"));
    EXPECT_EQ(tool.run({"move", "folder", "spool"}).code, 1);
    EXPECT_EQ(textOf(tool / "file"), "text");
    EXPECT_EQ(textOf(tool / "other"), "older");
    EXPECT_TRUE(exists(tool / "folder/y"));
    EXPECT_TRUE(exists(tool / "spool/folder/x"));

    EXPECT_EQ(tool.run({"move", "--overwrite", "file", "other"}).code, 0);
    EXPECT_EQ(textOf(tool / "other"), "text");
}

TEST(Move, puts_a_folder_only_in_the_place_of_an_empty_one) {
    Tool tool;
    makeFolder(tool / "folder/y");
    makeFolder(tool / "spool/folder/x");
    Names const before = tool.content();
    ToolResult const refused = tool.run({"move", "--overwrite", "folder", "spool"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_EQ(refused.errors, "zbtool: cannot move 'folder' to 'spool/folder': Directory not empty\n");
    EXPECT_EQ(tool.content(), before);
    // The place of the source's own parent is none either.
    makeFolder(tool / "deep/deep");
    EXPECT_EQ(tool.run({"move", "--overwrite", "deep/deep", "."}).code, 1);
    EXPECT_TRUE(exists(tool / "deep/deep"));

    std::filesystem::remove(tool / "spool/folder/x");
    EXPECT_EQ(tool.run({"move", "--overwrite", "folder", "spool"}).code, 0);
    EXPECT_EQ(tool.content("spool"), (Names{"folder/", "folder/y/"}));
}

TEST(Move, refuses_two_sources_of_one_name) {
    Tool tool;
    makeFolder(tool / "spool");
    makeFolder(tool / "1");
    makeFolder(tool / "2");
    put(tool / "1/file", "one");
    put(tool / "2/file", "two");
    put(tool / "other", "text");
    Names const before = tool.content();
    for (char const* command : {"move", "copy"}) {
        SCOPED_TRACE(command);
        ToolResult const refused = tool.run({command, "--overwrite", "other", "1/file", "2/../2/file/", "spool"});
        EXPECT_EQ(refused.code, 2);
        EXPECT_EQ(refused.output, "");
        EXPECT_TRUE(isOneLineAbout(refused.errors, "1/file"));
        EXPECT_TRUE(isOneLineAbout(refused.errors, "2/../2/file"));
        EXPECT_EQ(tool.content(), before);
    }
}

TEST(Move, tells_what_is_missing) {
    Tool tool;
    put(tool / "file", "text");
    ToolResult const missing = tool.run({"move", "gone", "other"});
    EXPECT_EQ(missing.code, 1);
    EXPECT_TRUE(isOneLineAbout(missing.errors, "gone"));
    ToolResult const nowhere = tool.run({"move", "file", "no/such"});
    EXPECT_EQ(nowhere.code, 1);
    EXPECT_TRUE(isOneLineAbout(nowhere.errors, "'no/such'"));
    EXPECT_EQ(textOf(tool / "file"), "text");
}

TEST(Move, never_moves_a_folder_into_itself) {
    Tool tool;
    makeFolder(tool / "folder/below");
    EXPECT_EQ(tool.run({"move", "folder", "folder/below"}).code, 1);
    EXPECT_EQ(tool.run({"move", "--overwrite", "folder", "folder"}).code, 1);
    EXPECT_EQ(tool.content(), (Names{"folder/", "folder/below/"}));
}

} // namespace
