#include "zor_basis/text.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(BufStr, breathes) {
    BufStr<15> name("job");
    name << "-" << 42;
    EXPECT_EQ(name, "job-42");
    BufStr<255> path(name);
    path += std::string("/page");
    EXPECT_EQ(path, "job-42/page");
    EXPECT_EQ(path.size(), 11U);
}
