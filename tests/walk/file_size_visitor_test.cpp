#include <zor_basis/walk.h>

#include "basis/files/system_calls.h"
#include "tests/walk/visited_tree.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileSizeVisitorOnDisk : VisitedTree {
    FileSizeVisitorOnDisk() { xos_HostCallsReset(); }
    ~FileSizeVisitorOnDisk() override { systemCalls = usual; }

    /// The platform's calls since the start of the test.
    static std::string calls() {
        std::string text;
        for (char const* name :
             {"xos_DirOpenEx", "xos_DirNextEx", "xos_DirClose", "xos_StrCmp", "xos_FileStatByNameEx"}) {
            text += std::to_string(xos_HostCalls(name)) + " ";
        }
        return text;
    }

    SystemCalls const usual = systemCalls;
};

} // namespace

TEST_F(FileSizeVisitorOnDisk, sums_sizes) {
    EXPECT_EQ(FileSizeVisitor::Get(at("src/a"), false), 2);
    EXPECT_EQ(FileSizeVisitor::Get(at("none"), true), 0);
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), false), 2) << "the files of the top level";
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), true), 9);
    EXPECT_EQ(FileSizeVisitor::Get(at("src/d"), false), 3);
    FileSizeVisitor flat(false);
    EXPECT_TRUE(walk("src", flat));
    EXPECT_EQ(flat.total(), 2 + 3);
    FileSizeVisitor whole(true);
    EXPECT_TRUE(walk("src", whole));
    EXPECT_EQ(whole.total(), 9);
}

TEST_F(FileSizeVisitorOnDisk, makes_the_platform_calls_of_a_walk_in_each_folder) {
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), true), 9);
    // Three folders, five entries, and the end of each folder.
    EXPECT_EQ(calls(), "3 8 3 5 0 ");
    EXPECT_EQ(std::string(xos_HostLastCall("xos_DirOpenEx")), "\"" + (scratch / "src/d/e") + "\", null, 0x0");
    EXPECT_EQ(xos_HostLastCall("xos_StrCmp"), std::string("\"c\", \"__MACOS\""));
    xos_HostCallsReset();
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), false), 2);
    EXPECT_EQ(calls(), "1 2 1 1 0 ");
    xos_HostCallsReset();
    EXPECT_EQ(FileSizeVisitor::Get(at("src/a"), true), 2);
    EXPECT_EQ(FileSizeVisitor::Get(at("none"), true), 0);
    EXPECT_EQ(calls(), "0 0 0 0 1 ");
}

TEST_F(FileSizeVisitorOnDisk, passes_over_what_walks_pass_over) {
    makeFolder(scratch / "src/__MACOS");
    put(scratch / "src/__MACOS/file", "12345");
    put(scratch / "src/d/__MACOS", "12345");
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), true), 9);
}

TEST_F(FileSizeVisitorOnDisk, asks_by_the_path_where_a_folder_cannot_tell) {
    systemCalls.statusIn = [](SystemCalls::Folder, char const*, xos_Stat&) { return false; };
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), true), 9);
    systemCalls = usual;
    systemCalls.openFolder = [](char const*) { return SystemCalls::NO_FOLDER; };
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), true), 9);
}

TEST_F(FileSizeVisitorOnDisk, counts_an_entry_that_vanishes_as_nothing_after_asking_the_platform) {
    static SystemCalls calledThen;
    static std::string vanishing;
    calledThen = usual;
    vanishing = scratch / "src/a";
    systemCalls.openFolder = [](char const* path) {
        std::filesystem::remove(vanishing);
        return calledThen.openFolder(path);
    };
    EXPECT_EQ(FileSizeVisitor::Get(at("src"), true), 7);
    EXPECT_EQ(calls(), "3 8 3 5 2 ") << "as a file, and then as what might be a folder";
}
