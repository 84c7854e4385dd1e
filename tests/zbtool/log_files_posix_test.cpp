#include "tests/zbtool/prepared_child_posix.h"
#include "tests/zbtool/tool.h"

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

} // namespace
