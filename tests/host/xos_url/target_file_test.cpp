#include "host/xos_url/target_file.h"

#include "tests/support/scratch.h"
#include "tests/support/system_error.h"

#include <gtest/gtest.h>

#include <string>

namespace {

using host::TargetFile;

TEST(HostTargetFile, appears_when_it_is_committed) {
    Scratch const scratch;
    TargetFile file{scratch / "target"};
    ASSERT_TRUE(file.open());
    EXPECT_TRUE(file.write("a\0b", 3));
    EXPECT_TRUE(file.write("\r\n", 2));
    EXPECT_FALSE(exists(scratch / "target"));
    EXPECT_TRUE(file.commit());
    EXPECT_EQ(textOf(scratch / "target"), std::string("a\0b\r\n", 5));
    EXPECT_EQ(scratch.content(), Names{"target"});
}

TEST(HostTargetFile, replaces_a_file_only_when_it_is_committed) {
    Scratch const scratch;
    put(scratch / "target", "as before");
    {
        TargetFile file{scratch / "target"};
        ASSERT_TRUE(file.open());
        EXPECT_TRUE(file.write("new", 3));
    }
    EXPECT_EQ(textOf(scratch / "target"), "as before") << "not committed";
    EXPECT_EQ(scratch.content(), Names{"target"});
    TargetFile file{scratch / "target"};
    ASSERT_TRUE(file.open());
    EXPECT_TRUE(file.commit());
    EXPECT_EQ(textOf(scratch / "target"), "");
}

TEST(HostTargetFile, leaves_nothing_where_it_cannot_be_put) {
    Scratch const scratch;
    makeFolder(scratch / "folder");
    {
        TargetFile file{scratch / "folder"};
        ASSERT_TRUE(file.open());
        EXPECT_TRUE(file.write("x", 1));
        clearSystemError();
        EXPECT_FALSE(file.commit());
        EXPECT_NE(systemError(), 0);
    }
    EXPECT_EQ(scratch.content(), Names{"folder/"});
    TargetFile nowhere{scratch / "missing/target"};
    EXPECT_FALSE(nowhere.open());
}

TEST(HostTargetFile, does_not_mix_with_another_for_the_same_target) {
    Scratch const scratch;
    TargetFile first{scratch / "target"};
    TargetFile second{scratch / "target"};
    ASSERT_TRUE(first.open());
    ASSERT_TRUE(second.open());
    EXPECT_TRUE(first.write("first", 5));
    EXPECT_TRUE(second.write("second", 6));
    EXPECT_TRUE(first.commit());
    EXPECT_EQ(textOf(scratch / "target"), "first");
    EXPECT_TRUE(second.commit());
    EXPECT_EQ(textOf(scratch / "target"), "second");
}

} // namespace
