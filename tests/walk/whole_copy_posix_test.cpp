// Whole trees copied by one walk, links, read-only files and odd names among them, compared by the system's own
// program.

#include <zor_basis/walk.h>

#include "tests/support/random_steps.h"
#include "tests/walk/random_tree.h"

#include <gtest/gtest.h>

#include <cstdlib>

using namespace ZOR_Basis;

TEST(WholeCopyPosix, differs_in_nothing_that_diff_sees) {
    Scratch scratch;
    auto random = randomSource();
    std::string const source = scratch / "source";
    std::string const copy = scratch / "copy";
    makeFolder(source);
    makeFolder(copy);
    fillRandomly(source, 3, random);
    put(source + "/Gr\xC3\xBC\xC3\x9F"
                 "e",
        "x");
    put(source + "/not \xFF UTF-8", "x");
    put(source + "/" + std::string(255, 'n'), "x");
    put(source + "/read only", "x");
    std::filesystem::permissions(source + "/read only", std::filesystem::perms::owner_read);
    std::filesystem::create_symlink("read only", source + "/link");
    std::filesystem::create_symlink("nowhere", source + "/dangling");

    FileCopyVisitor copier((Str(copy)), false, true);
    ASSERT_TRUE(FileIterator(source.c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&copier, false, true));
    std::string const command = "diff -r --no-dereference '" + source + "' '" + copy + "' >/dev/null";
    EXPECT_EQ(std::system(command.c_str()), 0);
    put(copy + "/read only 2", "x");
    EXPECT_NE(std::system(command.c_str()), 0) << "diff would see it";
}
