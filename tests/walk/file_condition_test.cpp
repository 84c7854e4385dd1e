#include <zor_basis/walk/file_condition.h>

#include <zor_basis/files/file_entry.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(FileConditionByDefault, keeps_everything) {
    FileCondition all;
    FileEntry entry(FStat::ST_FILE, Str("d"), "n", 0, 0);
    EXPECT_TRUE(all.acceptName(nullptr, "n"));
    EXPECT_TRUE(all.acceptEntry(&entry));
}
