#include "tests/zbtool/tool.h"

#include "tests/support/table.h"

#include <gtest/gtest.h>

namespace {

/// A tree of three files in three folders, one of them empty.
void makeTree(std::string const& top) {
    makeFolder(top + "/deep/deeper");
    makeFolder(top + "/empty");
    put(top + "/one.txt", "one");
    put(top + "/deep/two.txt", "two");
    put(top + "/deep/deeper/large.bin", std::string(100'000, 'L'));
}

Names const TREE{"deep/", "deep/deeper/", "deep/deeper/large.bin", "deep/two.txt", "empty/", "one.txt"};

TEST(Copy, makes_a_copy_of_a_whole_folder) {
    Tool tool;
    makeTree(tool / "job");
    EXPECT_EQ(tool.run({"copy", "job", "copy"}), (ToolResult{0, "copied job to copy\n", ""}));
    EXPECT_EQ(tool.content("copy"), TREE);
    EXPECT_EQ(textOf(tool / "copy/deep/deeper/large.bin"), std::string(100'000, 'L'));
    EXPECT_EQ(tool.content("job"), TREE);
}

TEST(Copy, goes_into_an_existing_folder) {
    Tool tool;
    makeTree(tool / "job");
    makeFolder(tool / "spool");
    for (char const* source : {"job", "job/", "job/deep/.."}) {
        SCOPED_TRACE(source);
        EXPECT_EQ(tool.run({"copy", source, "spool"}).code, 0);
        EXPECT_EQ(tool.content("spool/job"), TREE);
        std::filesystem::remove_all(tool / "spool/job");
    }
}

TEST(Copy, copies_several_sources_into_a_folder_only) {
    Tool tool;
    put(tool / "a", "A");
    put(tool / "b", "B");
    ToolResult const refused = tool.run({"copy", "a", "b", "c"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_TRUE(isOneLineAbout(refused.errors, "c"));
    EXPECT_FALSE(exists(tool / "c"));
    makeFolder(tool / "c");
    EXPECT_EQ(tool.run({"copy", "a", "b", "c"}).output, "copied a to c/a\ncopied b to c/b\n");
    EXPECT_EQ(tool.content("c"), (Names{"a", "b"}));
}

TEST(Copy, spares_existing_files_unless_told_to_overwrite) {
    Tool tool;
    makeTree(tool / "job");
    makeFolder(tool / "spool/job/deep");
    put(tool / "spool/job/deep/two.txt", "older");
    put(tool / "spool/job/other.txt", "other");
    ToolResult const refused = tool.run({"copy", "job", "spool"});
    EXPECT_EQ(refused.code, 1);
    EXPECT_TRUE(isOneLineAbout(refused.errors, "'spool/job/deep/two.txt'"));
    EXPECT_EQ(textOf(tool / "spool/job/deep/two.txt"), "older");

    EXPECT_EQ(tool.run({"copy", "--overwrite", "job", "spool"}).code, 0);
    EXPECT_EQ(textOf(tool / "spool/job/deep/two.txt"), "two");
    EXPECT_EQ(textOf(tool / "spool/job/other.txt"), "other");
}

TEST(Copy, copies_a_file_that_takes_long) {
    Tool tool;
    std::string const large(20 << 20, 'L');
    put(tool / "large", large);
    EXPECT_EQ(tool.run({"copy", "large", "copy"}).code, 0);
    EXPECT_TRUE(textOf(tool / "copy") == large);
    EXPECT_EQ(tool.content(), (Names{"copy", "large"}));
    put(tool / "copy", "older");
    EXPECT_EQ(tool.run({"copy", "large", "copy"}).code, 1);
    EXPECT_EQ(textOf(tool / "copy"), "older");
    EXPECT_EQ(tool.run({"copy", "large", "copy", "--overwrite"}).code, 0);
    EXPECT_TRUE(textOf(tool / "copy") == large);
    EXPECT_EQ(tool.content(), (Names{"copy", "large"}));
}

TEST(Copy, never_copies_a_folder_into_itself) {
    Tool tool;
    makeTree(tool / "job");
    for (char const* target : {"job", "job/deep", "job/new", "./job/deep/../new", "job/empty/"}) {
        SCOPED_TRACE(target);
        ToolResult const refused = tool.run({"copy", "job", target});
        EXPECT_EQ(refused.code, 1);
        EXPECT_TRUE(isOneLineAbout(refused.errors, "'job'"));
        EXPECT_EQ(tool.content("job"), TREE);
    }
}

TEST(Copy, tells_what_is_missing) {
    Tool tool;
    put(tool / "file", "text");
    ToolResult const missing = tool.run({"copy", "gone", "copy"});
    EXPECT_EQ(missing.code, 1);
    EXPECT_TRUE(isOneLineAbout(missing.errors, "gone"));
    ToolResult const nowhere = tool.run({"copy", "file", "no/such/folder"});
    EXPECT_EQ(nowhere.code, 1);
    EXPECT_TRUE(isOneLineAbout(nowhere.errors, "'no/such/folder'"));
    EXPECT_EQ(tool.content(), Names{"file"});
}

} // namespace
