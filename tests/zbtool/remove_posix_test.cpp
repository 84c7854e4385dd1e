#include "tests/zbtool/prepared_child_posix.h"
#include "tests/zbtool/tool.h"

#include "tests/support/skip.h"

#include <gtest/gtest.h>

namespace fs = std::filesystem;

namespace {

/// "free", which everyone may change, with "closed", which contains a file that only its owner may remove.
void makeFolders(Tool const& tool) {
    makeFolder(tool / "free/closed");
    put(tool / "free/closed/file", "text");
    put(tool / "free/open", "text");
    fs::permissions(tool / "free", fs::perms::all);
    auto const readable =
        fs::perms::owner_read | fs::perms::owner_exec | fs::perms::others_read | fs::perms::others_exec;
    fs::permissions(tool / "free/closed", readable);
}

TEST(RemovePosix, tells_what_another_user_may_not_delete_and_deletes_the_rest) {
    if (!nobodyMayRun()) CASE_CANNOT_HOLD("other users cannot reach the program");
    Tool tool;
    makeFolders(tool);
    auto const end = PreparedChild({ZBTOOL, "delete", "--yes", "free"}, tool.path(), becomeNobody).wait();
    EXPECT_EQ(end.code, 1);
    EXPECT_EQ(end.errors, "zbtool: free/closed/file: Permission denied\n");
    EXPECT_EQ(tool.content("free"), (Names{"closed/", "closed/file"}));
    fs::permissions(tool / "free/closed", fs::perms::owner_all);
}

// The library counts an entry that it cannot examine as gone.
TEST(RemovePosix, does_not_take_what_it_cannot_see_for_gone) {
    if (!nobodyMayRun()) CASE_CANNOT_HOLD("other users cannot reach the program");
    Tool tool;
    makeFolder(tool / "hidden/folder");
    fs::permissions(tool / "hidden", fs::perms::owner_all);
    auto const end = PreparedChild({ZBTOOL, "delete", "--yes", "hidden/folder"}, tool.path(), becomeNobody).wait();
    EXPECT_EQ(end.errors, "zbtool: hidden/folder: Permission denied\n");
    EXPECT_EQ(end.code, 1);
}

TEST(RemovePosix, tells_which_folders_another_user_may_not_read) {
    if (!nobodyMayRun()) CASE_CANNOT_HOLD("other users cannot reach the program");
    Tool tool;
    makeFolder(tool / "tree/closed");
    put(tool / "tree/file", "1234");
    fs::permissions(tool / "tree/closed", fs::perms::owner_all);
    for (auto const& [command, output] : {std::pair("size", "4\ttree\n"), {"count", "3\ttree\n"}, {"find", ""}}) {
        SCOPED_TRACE(command);
        std::vector<std::string> words{ZBTOOL, command, "tree"};
        if (std::string(command) == "find") words.push_back("none");
        auto const end = PreparedChild(words, tool.path(), becomeNobody).wait();
        EXPECT_EQ(end.code, 1);
        EXPECT_EQ(end.errors, "zbtool: tree/closed: Permission denied\n");
        EXPECT_EQ(end.output, output);
    }
}

TEST(RemovePosix, removes_a_link_and_not_its_target) {
    Tool tool;
    makeFolder(tool / "folder");
    put(tool / "folder/file", "text");
    makeFolder(tool / "tree");
    fs::create_symlink(tool / "folder", tool / "tree/link");
    fs::create_symlink(tool / "folder", tool / "link");
    EXPECT_EQ(tool.run({"delete", "--yes", "link", "tree"}).code, 0);
    EXPECT_EQ(tool.content(), (Names{"folder/", "folder/file"}));
}

TEST(RemovePosix, tells_that_the_output_is_full) {
    Tool tool;
    std::string const command = "exec " + ZBTOOL + " size . >/dev/full";
    auto const end = PreparedChild({"sh", "-c", command}, tool.path(), [] { return true; }).wait();
    EXPECT_EQ(end.code, 1);
    EXPECT_EQ(end.errors, "zbtool: standard output: No space left on device\n");
}

TEST(RemovePosix, refuses_the_folder_above) {
    Tool tool;
    makeFolder(tool / "folder/below");
    put(tool / "folder/file", "text");
    auto const end =
        PreparedChild({ZBTOOL, "delete", "--yes", ".."}, tool / "folder/below", [] { return true; }).wait();
    EXPECT_EQ(end.code, 1);
    EXPECT_TRUE(isOneLineAbout(end.errors, ".."));
    EXPECT_EQ(tool.content(), (Names{"folder/", "folder/below/", "folder/file"}));
}

} // namespace
