// What copying and moving have in common.

#include <zor_basis/walk.h>

#include "tests/support/table.h"
#include "tests/walk/visited_tree.h"

#include <gtest/gtest.h>

#include <initializer_list>

using namespace ZOR_Basis;

namespace {

struct TransferOfEntries : VisitedTree {};

} // namespace

TEST_F(TransferOfEntries, leaves_what_is_in_the_target_already_alone) {
    makeFolder(scratch / "src/d/t");
    put(scratch / "src/d/t/own", "own");
    FileCopyVisitor copy(at("src/d/t"), false, false);
    FileMoveVisitor move(at("src/d/t"), false);
    FileEntry own = entry("src/d/t", "own");
    EXPECT_TRUE(copy.perform(&own));
    EXPECT_TRUE(move.perform(&own));
    EXPECT_EQ(textOf(scratch / "src/d/t/own"), "own");
    FileCopyVisitor files(at("src/d/t"), true, false);
    EXPECT_TRUE(FileIterator(at("src"), LOOK_FILES, nullptr, nullptr).doIt(&files, true, true));
    EXPECT_EQ(scratch.content("src/d/t"), (Names{"a", "b", "c", "own"}));
}

TEST_F(TransferOfEntries, reports_every_failing_call) {
    struct Case {
        Row row;
        char const* function;
        char const* name;
        bool move;
        bool there;
    };
    for (Case const& c : {
             Case{{}, "xos_FileCopy", "a", false, false},
             Case{{}, "xos_DirCopy", "d", false, false},
             Case{{}, "xos_FileRemove", "a", false, true},
             Case{{}, "xos_FileRemove", "a", true, true},
         }) {
        SCOPED_TRACE(c.row);
        put(scratch / "dst/a", "old");
        if (!c.there) std::filesystem::remove(scratch / "dst/a");
        FileEntry one = entry("src", c.name);
        ASSERT_EQ(xos_HostFail(c.function, 0, 1), 0);
        FileCopyVisitor copy(at("dst"), true, true);
        FileMoveVisitor move(at("dst"), true);
        EXPECT_FALSE(c.move ? move.perform(&one) : copy.perform(&one));
        xos_HostFailClear();
        EXPECT_EQ(exists(scratch / "dst/a"), c.there);
        EXPECT_TRUE(exists(scratch / "src/a"));
    }
}

TEST_F(TransferOfEntries, keeps_a_directory_that_cannot_be_removed) {
    makeFolder(scratch / "dst/d/old");
    FileEntry folder = entry("src", "d");
    FileCopyVisitor copy(at("dst"), true, true);
    FileMoveVisitor move(at("dst"), true);
    FileDeleteVisitor remove;
    for (FileVisitor* visitor : std::initializer_list<FileVisitor*>{&copy, &move, &remove}) {
        ASSERT_EQ(xos_HostFail("xos_DirRemove", 0, 1), 0);
        EXPECT_FALSE(visitor->perform(&folder));
        EXPECT_EQ(scratch.content("dst"), (Names{"d/", "d/old/"}));
        EXPECT_EQ(scratch.content("src"), (Names{"a", "d/", "d/b", "d/e/", "d/e/c"}));
    }
}
