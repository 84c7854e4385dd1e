#include "tests/zbtool/tool.h"

#include <gtest/gtest.h>

namespace {

TEST(LogFiles, prints_all_sessions_in_their_order) {
    Tool tool;
    makeFolder(tool / "tmp/zb_log/render");
    for (int session : {0, 2, 10}) {
        put(tool / ("tmp/zb_log/render/" + std::to_string(session) + ".log"),
            "session " + std::to_string(session) + "\n");
    }
    for (char const* name : {"notes.log", "5x.log", "-1.log"})
        put(tool / ("tmp/zb_log/render/" + std::string(name)), "no session\n");
    EXPECT_EQ(tool.run({"log", "render"}), (ToolResult{0, "session 0\nsession 2\nsession 10\n", ""}));
    EXPECT_EQ(tool.run({"log", "render", "--session", "2"}).output, "session 2\n");
    Tool elsewhere;
    EXPECT_EQ(elsewhere.run({"log", "--root", tool.path(), "render", "--session", "10"}).output, "session 10\n");
}

TEST(LogFiles, tells_what_is_missing) {
    Tool tool;
    makeFolder(tool / "tmp/zb_log/render");
    ToolResult const missing = tool.run({"log", "gone"});
    EXPECT_EQ(missing.code, 1);
    EXPECT_TRUE(isOneLineAbout(missing.errors, "tmp/zb_log/gone"));
    ToolResult const empty = tool.run({"log", "render", "--session", "3"});
    EXPECT_EQ(empty.code, 1);
    EXPECT_TRUE(isOneLineAbout(empty.errors, "tmp/zb_log/render"));
    EXPECT_EQ(tool.run({"log"}).code, 2);
    EXPECT_EQ(tool.run({"log", "render", "--session", "x"}).code, 2);
}

} // namespace
