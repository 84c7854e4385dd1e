#include "basis/files/whole_entry.h"

#include "tests/support/scratch.h"
#include "tests/support/table.h"
#include "xos_host.h"

#include <zor_basis/files.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

namespace {

struct WholeEntry : testing::Test {
    WholeEntry() {
        put(scratch / "file", "text");
        makeFolder(scratch / "folder/inner");
    }
    ~WholeEntry() override { xos_HostFailClear(); }

    FPath at(char const* name) const { return {(scratch / name).c_str()}; }

    Scratch scratch;
};

struct Destination {
    Row row;
    char const* name;
    bool overwrite;
    bool isFreed;
    char const* failing; ///< a call of the platform layer, or none
    bool remains;
};

} // namespace

TEST_F(WholeEntry, frees_a_destination_that_may_be_overwritten) {
    for (Destination const& c : {
             Destination{{}, "none", false, true, nullptr, false},
             Destination{{}, "none", true, true, nullptr, false},
             Destination{{}, "file", false, false, nullptr, true},
             Destination{{}, "folder", false, false, nullptr, true},
             Destination{{}, "file", true, false, "xos_FileRemove", true},
             Destination{{}, "folder", true, false, "xos_DirRemove", true},
             Destination{{}, "file", true, true, "xos_DirRemove", false},
             Destination{{}, "folder", true, true, "xos_FileRemove", false},
         }) {
        SCOPED_TRACE(c.row);
        ASSERT_TRUE(c.failing == nullptr || xos_HostFail(c.failing, 0, 1) == 0);
        EXPECT_EQ(freeDestination(at(c.name), c.overwrite), c.isFreed);
        EXPECT_EQ(exists(scratch / c.name), c.remains);
        xos_HostFailClear();
    }
}

TEST_F(WholeEntry, goes_by_the_status_that_it_gets) {
    EXPECT_TRUE(freeDestination(at("file"), FStat(), false)) << "nothing was there when it was examined";
    EXPECT_TRUE(exists(scratch / "file"));
}

TEST_F(WholeEntry, removes_files_and_trees_each_by_its_own_call) {
    EXPECT_FALSE(removeFile(at("folder")));
    EXPECT_FALSE(removeTree(at("file")));
    EXPECT_FALSE(removeFile(nullptr));
    EXPECT_EQ(scratch.content(), (Names{"file", "folder/", "folder/inner/"}));
    EXPECT_TRUE(removeFile(at("file")));
    EXPECT_TRUE(removeTree(at("folder")));
    EXPECT_EQ(scratch.content(), Names{});
}

TEST_F(WholeEntry, links_and_copies_where_no_link_can_be_made) {
    EXPECT_TRUE(linkOrCopy(at("link"), at("file")));
    put(scratch / "link", "both");
    EXPECT_EQ(textOf(scratch / "file"), "both");
    ASSERT_EQ(xos_HostFail("xos_FileHardLink", 0, 1), 0);
    put(scratch / "copy", "old");
    EXPECT_TRUE(linkOrCopy(at("copy"), at("file")));
    put(scratch / "file", "changed");
    EXPECT_EQ(textOf(scratch / "copy"), "both");
    EXPECT_FALSE(linkOrCopy(at("other"), at("none")));
}
