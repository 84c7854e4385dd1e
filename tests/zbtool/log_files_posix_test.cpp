#include "tests/zbtool/on_terminal_posix.h"
#include "tests/zbtool/prepared_child_posix.h"

#include <gtest/gtest.h>

#include <chrono>
#include <csignal>
#include <fstream>
#include <thread>

namespace {

void append(std::string const& path, std::string const& text) {
    std::ofstream(path, std::ios::binary | std::ios::app) << text;
}

TEST(LogFilesPosix, follows_the_lines_and_sessions_that_come) {
    Tool tool;
    std::string const folder = tool / "tmp/zb_log/render";
    makeFolder(folder);
    put(folder + "/0.log", "first\n");
    std::string const output = tool / "output";
    std::string const command = "exec " + ZBTOOL + " log render --follow >" + output;
    PreparedChild child({"sh", "-c", command}, tool.path(),
                        [&] { return ::setenv("XOS_ROOT", tool.path().c_str(), 1) == 0; });
    std::string expected;
    auto const expect = [&](std::string const& text) {
        expected += text;
        for (int i = 0; i < 200 && textOf(output) != expected; ++i)
            std::this_thread::sleep_for(std::chrono::milliseconds(50));
        EXPECT_EQ(textOf(output), expected);
    };
    expect("first\n");
    append(folder + "/0.log", "second\n");
    expect("second\n");
    append(folder + "/0.log", "third\n");
    append(folder + "/1.log", "the next session, in more bytes than before\n");
    expect("third\nthe next session, in more bytes than before\n");
    ::kill(child.process(), SIGINT);
    auto const end = child.wait();
    EXPECT_EQ(end.signal, SIGINT);
    EXPECT_EQ(end.errors, "");
}

TEST(LogFilesPosix, do_not_steer_a_terminal) {
    Tool tool;
    std::string const folder = tool / "tmp/zb_log/render";
    makeFolder(folder);
    // The character behind the filling lies across the end of the first piece that is read.
    std::string const filling(64 * 1024 - 1, 'x');
    put(folder + "/0.log", filling + "\xC3\xA9\tred \x1b[31m\n" +
                               "to the front\r, title \xC2\x9D"
                               "2;x\n");
    std::string const expected = filling + "\xC3\xA9\tred \\x1b[31m\r\nto the front\\x0d, title \\xc2\\x9d2;x\r\n";
    ToolResult const shown = runOnTerminal(tool.path(), {"log", "render", "--root", tool.path()}, "");
    EXPECT_TRUE(shown.output == expected) << shown.output.substr(filling.size() - 10);
    ToolResult const passedOn = tool.run({"log", "render"});
    EXPECT_NE(passedOn.output.find("red \x1b[31m\n"), std::string::npos) << "for other programs lines stay as they are";
}

} // namespace
