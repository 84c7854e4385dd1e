#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

TEST(Remove, deletes_files_and_whole_folders) {
    Tool tool;
    makeFolder(tool / "folder/below");
    put(tool / "folder/below/file", "text");
    put(tool / "file", "text");
    put(tool / "other", "text");
    EXPECT_EQ(tool.run({"delete", "--yes", "folder", "file"}), (ToolResult{0, "deleted folder\ndeleted file\n", ""}));
    EXPECT_EQ(tool.content(), Names{"other"});
}

TEST(Remove, asks_for_yes_where_there_is_no_terminal) {
    Tool tool;
    put(tool / "file", "text");
    ToolResult const refused = tool.run({"delete", "file"}, "y\n");
    EXPECT_EQ(refused.code, 2);
    EXPECT_TRUE(isOneLineAbout(refused.errors, "delete"));
    EXPECT_TRUE(exists(tool / "file"));
}

TEST(Remove, tells_what_is_missing_and_deletes_the_rest) {
    Tool tool;
    put(tool / "file", "text");
    ToolResult const result = tool.run({"delete", "--yes", "gone", "file"});
    EXPECT_EQ(result.code, 1);
    EXPECT_TRUE(isOneLineAbout(result.errors, "gone"));
    EXPECT_EQ(tool.content(), Names{});
}

TEST(Remove, spares_the_root_of_a_file_system) {
    Tool tool;
    std::string const root = std::filesystem::path(tool.path()).root_path().generic_string();
    ToolResult const result = tool.run({"delete", "--yes", root + "."});
    EXPECT_EQ(result.code, 1);
    EXPECT_TRUE(isOneLineAbout(result.errors, root));
    EXPECT_TRUE(exists(tool.path()));
}

TEST(Remove, refuses_a_folder_that_has_no_name_and_removes_nothing) {
    Tool tool;
    makeFolder(tool / "folder/below");
    put(tool / "folder/file", "text");
    Names const before = tool.content();
    for (std::string const path : {".", "./", "folder/.", "folder/./", "folder/below/..", "folder/below/..//"}) {
        SCOPED_TRACE(path);
        ToolResult const result = tool.run({"delete", "--yes", "folder/file", path});
        EXPECT_EQ(result.code, 1);
        EXPECT_EQ(result.output, "");
        EXPECT_TRUE(isOneLineAbout(result.errors, path.substr(0, path.find_last_not_of('/') + 1)));
        EXPECT_EQ(tool.content(), before);
    }
    put(tool / "folder/...x..", "text");
    EXPECT_EQ(tool.run({"delete", "--yes", "folder/...x.."}).code, 0);
}

} // namespace
