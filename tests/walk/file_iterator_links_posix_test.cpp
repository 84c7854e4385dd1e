// Links in trees, which Linux does not follow.

#include <zor_basis/walk.h>

#include "tests/support/scratch.h"
#include "tests/walk/recorder.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileIteratorLinksPosix : testing::Test {
    FileIteratorLinksPosix() {
        makeFolder(scratch / "out");
        makeFolder(scratch / "tree");
        makeFolder(scratch / "dst");
        put(scratch / "out/secret", "12345");
        std::filesystem::create_directory_symlink("../out", scratch / "tree/link");
        std::filesystem::create_directory_symlink(".", scratch / "tree/self");
    }

    Scratch scratch;
};

} // namespace

TEST_F(FileIteratorLinksPosix, are_listed_as_files_and_reported_as_directories_and_not_entered) {
    Recorder seen;
    FileIterator((scratch / "tree").c_str(), LOOK_FILES, nullptr, nullptr).doIt(&seen, true, true);
    EXPECT_EQ(seen.below(scratch / "tree"), (std::multiset<std::string>{"link/", "self/"}));
    Recorder folders;
    FileIterator((scratch / "tree").c_str(), LOOK_DIRS, nullptr, nullptr).doIt(&folders, true, true);
    EXPECT_TRUE(folders.paths.empty());
}

TEST_F(FileIteratorLinksPosix, may_be_where_a_walk_starts) {
    Recorder seen;
    FileIterator((scratch / "tree/link").c_str(), LOOK_FILES, nullptr, nullptr).doIt(&seen, true, true);
    EXPECT_EQ(seen.paths, std::vector<std::string>{scratch / "tree/link/secret"});
}

TEST_F(FileIteratorLinksPosix, count_nothing) {
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch / "tree"), true), 0);
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch / "tree/link"), true), 0);
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch / "out"), true), 5);
}

TEST_F(FileIteratorLinksPosix, are_copied_and_removed_themselves) {
    FileCopyVisitor copy(Str(scratch / "dst"), false, true);
    EXPECT_TRUE(FileIterator((scratch / "tree").c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&copy, false, true));
    EXPECT_TRUE(std::filesystem::is_symlink(scratch / "dst/link"));
    EXPECT_EQ(std::filesystem::read_symlink(scratch / "dst/link"), "../out");
    FileDeleteVisitor remove;
    EXPECT_TRUE(FileIterator((scratch / "tree").c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&remove, false, true));
    EXPECT_EQ(scratch.content("tree"), Names{});
    EXPECT_EQ(textOf(scratch / "out/secret"), "12345");
}
