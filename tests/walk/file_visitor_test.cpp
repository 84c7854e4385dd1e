#include <zor_basis/walk/file_visitor.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(FileVisitorByDefault, never_stops) {
    struct : FileVisitor {
        bool perform(FileEntry* /*entry*/) override { return true; }
    } visitor;
    EXPECT_FALSE(visitor.stop());
}
