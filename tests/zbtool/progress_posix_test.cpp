#include "tests/zbtool/on_terminal_posix.h"

#include <gtest/gtest.h>

#include <csignal>
#include <pty.h>
#include <sys/wait.h>
#include <termios.h>
#include <unistd.h>

namespace {

std::size_t timesIn(std::string const& text, std::string const& part) {
    std::size_t times = 0;
    for (std::size_t at = text.find(part); at != std::string::npos; at = text.find(part, at + 1)) ++times;
    return times;
}

void makeFiles(Tool const& tool, int files) {
    makeFolder(tool / "job");
    for (int i = 0; i < files; ++i) put(tool / ("job/" + std::to_string(i)), std::string(50'000, 'x'));
}

TEST(ProgressPosix, is_shown_on_a_terminal_with_the_total_and_what_is_left) {
    Tool tool;
    makeFiles(tool, 3'000);
    ToolResult const result = runOnTerminal(tool.path(), {"copy", "job", "copy"}, "");
    EXPECT_EQ(result.code, 0);
    EXPECT_GE(timesIn(result.output, "\rcopying  "), 1u) << result.output;
    EXPECT_GE(timesIn(result.output, " of 3001 entries"), 1u) << result.output;
    EXPECT_GE(timesIn(result.output, " left"), 1u) << result.output;
    EXPECT_NE(result.output.find("done:  3001 entries, 143.1 MiB, "), std::string::npos) << result.output;
    EXPECT_EQ(tool.run({"count", "copy"}).output, "3001\tcopy\n");
}

TEST(ProgressPosix, deleting_asks_on_a_terminal_and_tells_how_much) {
    Tool tool;
    makeFiles(tool, 10);
    for (char const* answer : {"n\n", "\n", "never\n"}) {
        SCOPED_TRACE(answer);
        ToolResult const kept = runOnTerminal(tool.path(), {"delete", "job"}, answer);
        EXPECT_EQ(kept.code, 1);
        EXPECT_NE(kept.output.find("delete job: 11 entries, 488.3 KiB? [y/N]"), std::string::npos) << kept.output;
        EXPECT_EQ(tool.content("job").size(), 10u);
    }
    ToolResult const gone = runOnTerminal(tool.path(), {"delete", "job"}, "y\n");
    EXPECT_EQ(gone.code, 0);
    EXPECT_EQ(tool.content(), Names{});
}

bool showsInput(int terminal) {
    termios settings{};
    return ::tcgetattr(terminal, &settings) == 0 && (settings.c_lflag & ECHO) != 0;
}

TEST(ProgressPosix, an_interrupted_question_for_a_secret_leaves_a_terminal_that_shows_input) {
    Tool tool;
    put(tool / "plain", "text");
    for (int const signal : {SIGINT, SIGQUIT, SIGTERM, SIGHUP}) {
        SCOPED_TRACE(signal);
        int terminal = -1;
        pid_t const process = ::forkpty(&terminal, nullptr, nullptr, nullptr);
        if (process == 0) {
            std::string const program = programBeside("zbtool");
            if (::chdir(tool.path().c_str()) == 0)
                ::execl(program.c_str(), "zbtool", "crypt", "encrypt", "plain", "hidden", nullptr);
            ::_exit(127);
        }
        for (int i = 0; i < 10'000 && showsInput(terminal); ++i) ::usleep(1'000);
        EXPECT_FALSE(showsInput(terminal));
        if (signal == SIGINT)
            EXPECT_EQ(::write(terminal, "\x03", 1), 1);
        else
            ::kill(process, signal);
        int status = 0;
        EXPECT_EQ(::waitpid(process, &status, 0), process);
        EXPECT_TRUE(WIFSIGNALED(status) && WTERMSIG(status) == signal);
        EXPECT_TRUE(showsInput(terminal));
        ::close(terminal);
    }
    EXPECT_FALSE(exists(tool / "hidden"));
}

} // namespace
