#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

void makeManyFolders(std::string const& top) {
    for (int i = 0; i < 30; ++i) {
        std::string const folder = top + "/folder-" + std::to_string(i) + "/below";
        makeFolder(folder);
        put(folder + "/file", std::string(static_cast<std::size_t>(i), 'x'));
    }
    makeFolder(top + "/__MACOS");
    put(top + "/__MACOS/file", "1234567890");
}

TEST(Tally, counts_everything_of_a_tree) {
    Tool tool;
    makeManyFolders(tool / "tree");
    put(tool / "file", "text");
    EXPECT_EQ(tool.run({"count", "tree", "file"}), (ToolResult{0, "93\ttree\n1\tfile\n", ""}));
    EXPECT_EQ(tool.run({"count", "--flat", "tree"}).output, "32\ttree\n");
    EXPECT_EQ(tool.run({"count", "--kinds", "tree"}).output, "31 files\t62 folders\t0 others\ttree\n");
    EXPECT_EQ(tool.run({"count", "--json", "tree"}).output,
              "{\"path\": \"tree\", \"files\": 31, \"folders\": 62, \"others\": 0, \"bytes\": 445}\n");
}

TEST(Tally, adds_up_the_sizes_of_files) {
    Tool tool;
    makeManyFolders(tool / "tree");
    put(tool / "tree/top", "12345");
    EXPECT_EQ(tool.run({"size", "tree", "tree/top"}), (ToolResult{0, "450\ttree\n5\ttree/top\n", ""}));
    EXPECT_EQ(tool.run({"size", "--flat", "tree"}).output, "5\ttree\n");
}

TEST(Tally, tells_what_is_missing_and_counts_the_rest) {
    Tool tool;
    put(tool / "file", "text");
    for (char const* command : {"count", "size"}) {
        SCOPED_TRACE(command);
        ToolResult const result = tool.run({command, "gone", "file"});
        EXPECT_EQ(result.code, 1);
        EXPECT_TRUE(isOneLineAbout(result.errors, "gone"));
        EXPECT_TRUE(result.output.ends_with("\tfile\n"));
    }
}

} // namespace
