#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

TEST(Machine, tells_what_the_queries_say) {
    Tool tool;
    std::string const text = tool.run({"sys"}).output;
    EXPECT_NE(text.find("root                 " + tool.path() + "\n"), std::string::npos) << text;
    EXPECT_NE(text.find("temp                 " + tool.path() + "/tmp\n"), std::string::npos) << text;
    EXPECT_NE(text.find("\nprocessors           "), std::string::npos) << text;
    std::string const json = tool.run({"sys", "--json"}).output;
    EXPECT_EQ(json.find("{\"root\": \"" + tool.path() + "\", "), 0u) << json;
    EXPECT_TRUE(json.ends_with("}\n"));
}

} // namespace
