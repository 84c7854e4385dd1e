// What the command interpreter of this system alone can show.

#include "basis/platform/xos_basics.h"
#include "tests/support/scratch.h"

#include <gtest/gtest.h>

#include <chrono>
#include <csignal>
#include <fcntl.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace {

using namespace std::chrono_literals;

TEST(HostShellPosix, starts_a_long_command_without_waiting_and_leaves_no_dead_child) {
    auto const start = std::chrono::steady_clock::now();
    for (int i = 0; i < 5; ++i) { EXPECT_EQ(xos_ShellExecuteEx("sleep 0.2", nullptr), 0); }
    EXPECT_LT(std::chrono::steady_clock::now() - start, 1s);
    auto const end = std::chrono::steady_clock::now() + 20s;
    while (waitpid(-1, nullptr, WNOHANG) != -1 && std::chrono::steady_clock::now() < end) {
        std::this_thread::sleep_for(10ms);
    }
    EXPECT_EQ(waitpid(-1, nullptr, WNOHANG), -1);
    EXPECT_EQ(errno, ECHILD);
}

TEST(HostShellPosix, gives_128_and_the_signal_of_a_killed_command) {
    std::int64_t code = 0;
    EXPECT_EQ(xos_ShellExecuteEx("kill -9 $$", &code), 0);
    EXPECT_EQ(code, 128 + SIGKILL);
}

TEST(HostShellPosix, runs_the_command_once_when_children_are_ignored) {
    Scratch const scratch;
    auto* const before = std::signal(SIGCHLD, SIG_IGN);
    std::int64_t code = 0;
    EXPECT_EQ(xos_ShellExecuteEx(("echo x >> " + (scratch / "log")).c_str(), &code), 0);
    std::signal(SIGCHLD, before);
    EXPECT_EQ(code, -1) << "nobody can know";
    EXPECT_EQ(textOf(scratch / "log"), "x\n");
}

TEST(HostShellPosix, hands_on_nothing_but_the_standard_descriptors) {
    int const leaked = open("/dev/null", O_RDONLY);
    std::int64_t code = 0;
    std::string const test = "test ! -e /proc/self/fd/" + std::to_string(leaked);
    EXPECT_EQ(xos_ShellExecuteEx(test.c_str(), &code), 0);
    EXPECT_EQ(code, 0);
    close(leaked);
}

TEST(HostShellPosix, blocks_no_signals_of_the_command) {
    sigset_t blocked;
    sigset_t before;
    sigemptyset(&blocked);
    sigaddset(&blocked, SIGTERM);
    pthread_sigmask(SIG_BLOCK, &blocked, &before);
    std::int64_t code = 0;
    EXPECT_EQ(xos_ShellExecuteEx("kill -15 $$; exit 3", &code), 0);
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
    EXPECT_EQ(code, 128 + SIGTERM);
}

TEST(HostShellPosix, goes_where_the_directory_says_whatever_the_search_path_of_cd) {
    Scratch const scratch;
    makeFolder(scratch / "other/name");
    makeFolder(scratch / "here/name");
    setenv("CDPATH", (scratch / "other").c_str(), 1);
    std::string const before = [] {
        char path[4096];
        return std::string(getcwd(path, sizeof path));
    }();
    ASSERT_EQ(chdir((scratch / "here").c_str()), 0);
    std::int64_t code = 0;
    EXPECT_EQ(xos_ShellExecuteEx("cd name& echo x > mark", &code), 0);
    ASSERT_EQ(chdir(before.c_str()), 0);
    unsetenv("CDPATH");
    EXPECT_TRUE(exists(scratch / "here/name/mark"));
}

} // namespace
