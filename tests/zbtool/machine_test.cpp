#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

/// The value of a member as it is written.
std::string valueOf(std::string const& json, std::string const& name) {
    std::size_t const place = json.find("\"" + name + "\": ");
    if (place == std::string::npos) return "0";
    std::size_t const begin = place + name.size() + 4;
    return json.substr(begin, json.find_first_of(",}", begin) - begin);
}

TEST(Machine, tells_what_the_queries_say) {
    Tool tool;
    std::string const text = tool.run({"sys"}).output;
    EXPECT_NE(text.find("root                 " + tool.path() + "\n"), std::string::npos) << text;
    EXPECT_NE(text.find("temp                 " + tool.path() + "/tmp\n"), std::string::npos) << text;
    EXPECT_NE(text.find("\nprocessors           "), std::string::npos) << text;
    std::string const json = tool.run({"sys", "--json"}).output;
    EXPECT_EQ(json.find("{\"root\": \"" + tool.path() + "\", "), 0u) << json;
    EXPECT_TRUE(json.ends_with("}\n"));
    EXPECT_TRUE(valueOf(json, "folder-is-local") == "true" || valueOf(json, "folder-is-local") == "false") << json;
    for (char const* name : {"processors", "ticks-per-second"}) EXPECT_GE(std::stoll(valueOf(json, name)), 1) << json;
}

} // namespace
