// A current folder of more than 512 bytes, which Windows gives to no process.

#include "tests/support/child.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

namespace fs = std::filesystem;

TEST(SysRootPosix, Kept_root_01_is_empty_once_where_the_current_folder_is_long) {
    Scratch const scratch(fs::canonical(fs::temp_directory_path()));
    fs::path folder = scratch.path();
    while (folder.string().size() < 600) folder /= std::string(50, 'd');
    fs::create_directories(folder);
    ChildResult const result = run({"root_child", {"copy", "copy", "copy"}, {{"XOS_ROOT", ""}}, folder.string()});
    EXPECT_EQ(result.exitCode, 0);
    EXPECT_EQ(result.output, "false <>\ntrue <" + folder.string() + ">\ntrue <" + folder.string() + ">\n");
}
