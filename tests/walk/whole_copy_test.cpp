// Whole trees copied by one walk, compared name by name and byte by byte.

#include <zor_basis/walk.h>

#include "tests/support/random_steps.h"
#include "tests/walk/random_tree.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct WholeCopy : testing::Test {
    WholeCopy() {
        makeFolder(scratch / "source");
        makeFolder(scratch / "copy");
        auto random = randomSource();
        fillRandomly(scratch / "source", 3, random);
    }
    bool copy(bool overwrite) const {
        FileCopyVisitor copier(Str(scratch / "copy"), overwrite, true);
        return FileIterator((scratch / "source").c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&copier, false, true);
    }
    void expectSame() const {
        Names const names = scratch.content("source");
        EXPECT_EQ(scratch.content("copy"), names);
        for (std::string const& name : names) {
            if (name.back() != '/') {
                EXPECT_EQ(textOf(scratch / ("copy/" + name)), textOf(scratch / ("source/" + name))) << name;
            }
        }
    }

    Scratch scratch;
};

} // namespace

TEST_F(WholeCopy, is_the_same_tree) {
    EXPECT_TRUE(copy(false));
    expectSame();
    EXPECT_EQ(FileSizeVisitor::Get(Str(scratch / "copy"), true), FileSizeVisitor::Get(Str(scratch / "source"), true));
}

TEST_F(WholeCopy, replaces_an_older_one_whole) {
    EXPECT_TRUE(copy(false));
    EXPECT_FALSE(copy(false));
    for (auto const& entry : std::filesystem::directory_iterator(scratch / "copy")) {
        if (entry.is_directory()) put((entry.path() / "left over").string(), "old");
    }
    EXPECT_TRUE(copy(true));
    expectSame();
}

TEST_F(WholeCopy, leaves_nothing_when_it_is_removed) {
    EXPECT_TRUE(copy(false));
    FileDeleteVisitor remover;
    EXPECT_TRUE(FileIterator((scratch / "copy").c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&remover, false, true));
    EXPECT_EQ(scratch.content("copy"), Names{});
}
