#include <zor_basis/walk/file_iterator.h>

#include <zor_basis/walk/file_iter_visitor.h>

#include "tests/walk/walked_folder.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct FileIterVisitorInAWalk : WalkedFolder {};

} // namespace

TEST_F(FileIterVisitorInAWalk, Kept_walk_07_starts_a_walk_in_every_directory_reported) {
    fill();
    Recorder inner;
    FileIterator second(LOOK_FILES);
    FileIterVisitor each(&second, &inner, false, true);
    FileIterator(scratch.path().c_str(), LOOK_BOTH, nullptr, nullptr).doIt(&each, false, true);
    EXPECT_EQ(inner.below(scratch.path()), Found{"d/c.txt"});
    FileIterVisitor deep(&second, &inner, true, true);
    inner = Recorder();
    FileEntry directory(FStat::ST_DIR, Str(scratch.path()), "d", 0, 0);
    EXPECT_TRUE(deep.perform(&directory));
    EXPECT_EQ(inner.below(scratch.path()), (Found{"d/c.txt", "d/e/f.TXT"}));
    inner.failing = {"c.txt"};
    EXPECT_FALSE(deep.perform(&directory));
    FileEntry file(FStat::ST_FILE, Str(scratch.path()), "d", 0, 0);
    EXPECT_TRUE(deep.perform(&file)) << "no directory";
    EXPECT_STREQ(second.next(), "c.txt") << "the iterator stays where it walked last";
}
