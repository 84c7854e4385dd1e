// What processes are on Linux: signals, descriptors, zombies, and each system call failing in turn.

#include <zor_basis/system/process.h>

#include "basis/system/process_calls_posix.h"

#include "tests/support/child.h"
#include "tests/support/scratch.h"
#include "tests/support/thread_facts.h"

#include <gtest/gtest.h>

#include <atomic>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <fcntl.h>
#include <string>
#include <sys/stat.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>
#include <vector>

using namespace ZOR_Basis;

namespace {

struct ProcessPosix : testing::Test {
    ~ProcessPosix() override { processCalls = real; }

    /// Runs a line of the shell and gives its exit code.
    static int shell(std::string const& command) {
        int code = -1;
        EXPECT_TRUE(Process::Create("/bin/sh", nullptr, ("sh -c \"" + command + "\"").c_str(), &code));
        return code;
    }

    /// A child that runs until it is ended.
    static unsigned long startEndless() {
        unsigned long id = 0;
        EXPECT_TRUE(Process::Create("/bin/sleep", &id, "sleep 60", nullptr));
        return id;
    }
    static unsigned long start(char const* program) {
        unsigned long id = 0;
        EXPECT_TRUE(Process::Create(program, &id, nullptr, nullptr));
        return id;
    }

    static bool hasChildren() { return waitid(P_ALL, 0, nullptr, WEXITED | WNOHANG | WNOWAIT) == 0; }

    /// Returns when a child has ended, which it stays.
    static void awaitEnd(unsigned long id) {
        siginfo_t end{};
        EXPECT_EQ(waitid(P_PID, static_cast<id_t>(id), &end, WEXITED | WNOWAIT), 0);
    }

    ProcessCalls const real = processCalls;
    Scratch scratch;
};

using ProcessFaultsPosix = ProcessPosix;

/* Calls that fail */

int noDescriptor(pid_t) { return errno = EMFILE, -1; }
int noSuchCall(pid_t) { return errno = ENOSYS, -1; }
int noPoll(pollfd*, nfds_t, int) { return errno = ENOMEM, -1; }
int noSignal(int, int) { return errno = EPERM, -1; }
int noWait(idtype_t, id_t, siginfo_t*, int) { return errno = ECHILD, -1; }
int noSpawn(pid_t*, char const*, posix_spawn_file_actions_t const*, posix_spawnattr_t const*, char* const*,
            char* const*) {
    return EAGAIN;
}

int interruptions = 0;
int interruptedPoll(pollfd* descriptors, nfds_t count, int timeout) {
    if (interruptions-- > 0) return errno = EINTR, -1;
    return poll(descriptors, count, timeout);
}
int interruptedWait(idtype_t kind, id_t id, siginfo_t* end, int flags) {
    if (interruptions-- > 0) return errno = EINTR, -1;
    return waitid(kind, id, end, flags);
}

} // namespace

TEST_F(ProcessPosix, gives_128_and_the_signal_that_ended_a_program) {
    EXPECT_EQ(shell("kill -9 $$"), 128 + SIGKILL);
    EXPECT_EQ(shell("kill -15 $$"), 128 + SIGTERM);
    EXPECT_EQ(shell("exit 200"), 200);
}

TEST_F(ProcessPosix, searches_the_path_for_the_first_word) {
    int code = -1;
    EXPECT_TRUE(Process::Create(nullptr, nullptr, "true", &code));
    EXPECT_EQ(code, 0);
    EXPECT_TRUE(Process::Create(nullptr, nullptr, " \tfalse ignored", &code));
    EXPECT_EQ(code, 1);
    EXPECT_TRUE(Process::Create(nullptr, nullptr, "\"sh\" -c \"exit 4\"", &code));
    EXPECT_EQ(code, 4);
    EXPECT_FALSE(Process::Create("true", nullptr, "true", &code)) << "an application is a path";
}

TEST_F(ProcessPosix, takes_backslashes_in_the_programs_path) {
    int code = -1;
    EXPECT_TRUE(Process::Create("\\bin\\true", nullptr, nullptr, &code));
    EXPECT_TRUE(Process::Create(nullptr, nullptr, "\\bin\\false", &code));
    EXPECT_EQ(code, 1);
}

TEST_F(ProcessPosix, runs_no_text_as_a_script) {
    std::string const script = scratch / "script";
    put(script, "exit 3\n");
    chmod(script.c_str(), 0700);
    int code = 5;
    EXPECT_FALSE(Process::Create(script.c_str(), nullptr, nullptr, &code));
    EXPECT_FALSE(Process::Create(nullptr, nullptr, script.c_str(), &code));
    put(script, "#!/bin/sh\nexit 3\n");
    EXPECT_TRUE(Process::Create(script.c_str(), nullptr, nullptr, &code));
    EXPECT_EQ(code, 3);
    chmod(script.c_str(), 0600);
    EXPECT_FALSE(Process::Create(script.c_str(), nullptr, nullptr, &code)) << "not to be run";
}

TEST_F(ProcessPosix, hands_on_nothing_but_the_standard_descriptors) {
    int const leaked = open("/dev/null", O_RDONLY);
    ASSERT_GT(leaked, 2);
    EXPECT_EQ(shell("test -e /proc/self/fd/" + std::to_string(leaked)), 1);
    EXPECT_EQ(shell("test -e /proc/self/fd/2"), 0);
    close(leaked);
}

TEST_F(ProcessPosix, hands_on_environment_and_folder_and_no_blocked_signals) {
    setenv("ZB_TEST_VARIABLE", "value", 1);
    EXPECT_EQ(shell("test $ZB_TEST_VARIABLE = value"), 0);
    unsetenv("ZB_TEST_VARIABLE");
    char* const folder = getcwd(nullptr, 0);
    EXPECT_EQ(shell("test $(pwd -P) = " + std::string(folder)), 0);
    std::free(folder);
    sigset_t blocked;
    sigset_t before;
    sigemptyset(&blocked);
    sigaddset(&blocked, SIGTERM);
    pthread_sigmask(SIG_BLOCK, &blocked, &before);
    EXPECT_EQ(shell("kill -15 $$; exit 3"), 128 + SIGTERM);
    pthread_sigmask(SIG_SETMASK, &before, nullptr);
}

TEST_F(ProcessPosix, leaves_no_zombie) {
    for (int i = 0; i < 20; ++i) EXPECT_EQ(shell("exit 2"), 2);
    EXPECT_FALSE(hasChildren());
}

TEST_F(ProcessPosix, starts_a_thousand_and_awaits_them_afterwards) {
    std::size_t const before = openHandles();
    std::vector<unsigned long> ids;
    for (int i = 0; i < 1000; ++i) ids.push_back(start("/bin/true"));
    for (unsigned long const id : ids) ASSERT_TRUE(Process::Wait(id));
    EXPECT_FALSE(hasChildren());
    EXPECT_EQ(openHandles(), before);
}

TEST_F(ProcessPosix, can_be_awaited_when_it_has_ended_but_once_only) {
    unsigned long const id = start("/bin/true");
    awaitEnd(id);
    EXPECT_TRUE(Process::Wait(id));
    EXPECT_FALSE(hasChildren());
    EXPECT_FALSE(Process::Wait(id));
}

TEST_F(ProcessPosix, need_not_be_a_child_to_be_awaited_and_ended) {
    std::string const file = scratch / "id";
    // The shell ends at once and leaves its own child behind.
    ASSERT_EQ(shell("sleep 60 >/dev/null & echo $! > " + file), 0);
    unsigned long const id = std::stoul(textOf(file));
    EXPECT_TRUE(Process::Terminate(id));
    // Whoever inherits orphans here may have taken it from the system by now, or never do so.
    Process::Wait(id);
    EXPECT_FALSE(Process::Terminate(id));
}

TEST_F(ProcessPosix, is_ended_at_once) {
    unsigned long const id = startEndless();
    EXPECT_TRUE(Process::Terminate(id));
    siginfo_t end{};
    EXPECT_EQ(waitid(P_PID, static_cast<id_t>(id), &end, WEXITED | WNOWAIT), 0);
    EXPECT_EQ(end.si_code, CLD_KILLED);
    EXPECT_EQ(end.si_status, SIGKILL);
    EXPECT_FALSE(Process::Terminate(id)) << "it has ended";
    EXPECT_TRUE(Process::Wait(id));
    EXPECT_FALSE(Process::Terminate(id)) << "it is gone";
}

TEST_F(ProcessPosix, is_awaited_by_two_threads_at_once) {
    unsigned long const id = startEndless();
    std::atomic<int> polling{0};
    static std::atomic<int>* counter;
    counter = &polling;
    processCalls.awaitDescriptor = [](pollfd* descriptors, nfds_t count, int timeout) {
        ++*counter;
        return poll(descriptors, count, timeout);
    };
    std::atomic<int> awaited{0};
    std::vector<std::thread> threads;
    for (int i = 0; i < 2; ++i) {
        threads.emplace_back([id, &awaited] { awaited += Process::Wait(id) ? 1 : 0; });
    }
    while (polling < 2) std::this_thread::yield();
    EXPECT_TRUE(kill(static_cast<pid_t>(id), SIGKILL) == 0);
    for (std::thread& thread : threads) thread.join();
    EXPECT_EQ(awaited, 2);
    EXPECT_FALSE(hasChildren());
}

TEST_F(ProcessPosix, leaves_children_of_others_alone) {
    unsigned long const other = start("/bin/true");
    EXPECT_EQ(shell("exit 1"), 1);
    awaitEnd(other);
    unsigned long const own = start("/bin/true");
    EXPECT_TRUE(Process::Wait(own));
    EXPECT_TRUE(hasChildren());
    EXPECT_TRUE(Process::Wait(other));
}

TEST_F(ProcessPosix, leaves_the_exit_status_of_the_applications_own_child) {
    pid_t const child = fork();
    if (child == 0) _exit(7);
    EXPECT_TRUE(Process::Wait(static_cast<unsigned long>(child)));
    int status = 0;
    EXPECT_EQ(waitpid(child, &status, WNOHANG), child);
    EXPECT_EQ(WEXITSTATUS(status), 7);
}

TEST_F(ProcessPosix, has_no_exit_code_where_children_are_ignored) {
    auto* const before = std::signal(SIGCHLD, SIG_IGN);
    EXPECT_EQ(shell("exit 3"), 0) << "nobody can know";
    std::signal(SIGCHLD, before);
    EXPECT_FALSE(hasChildren());
}

/* Faults */

TEST_F(ProcessFaultsPosix, a_program_that_cannot_be_started) {
    processCalls.spawn = noSpawn;
    processCalls.spawnFromPath = noSpawn;
    unsigned long id = 5;
    int code = 5;
    EXPECT_FALSE(Process::Create("/bin/true", &id, nullptr, &code));
    EXPECT_FALSE(Process::Create(nullptr, &id, "true", &code));
    EXPECT_EQ(id, 5u);
    EXPECT_EQ(code, 0);
}

TEST_F(ProcessFaultsPosix, an_end_that_cannot_be_learned) {
    processCalls.waitFor = noWait;
    EXPECT_EQ(shell("exit 3"), 0);
    unsigned long const id = start("/bin/true");
    EXPECT_TRUE(Process::Wait(id)) << "it has ended all the same";
    processCalls = real;
    while (waitid(P_ALL, 0, nullptr, WEXITED) == 0) {}
}

TEST_F(ProcessFaultsPosix, a_process_that_cannot_be_opened) {
    unsigned long const id = start("/bin/true");
    processCalls.openProcess = noDescriptor;
    EXPECT_FALSE(Process::Wait(id));
    EXPECT_FALSE(Process::Terminate(id));
    processCalls = real;
    EXPECT_TRUE(Process::Wait(id));
    EXPECT_FALSE(hasChildren()) << "it was remembered";
}

TEST_F(ProcessFaultsPosix, a_wait_that_fails_leaves_nothing_open) {
    std::size_t const before = openHandles();
    unsigned long const id = start("/bin/true");
    processCalls.awaitDescriptor = noPoll;
    EXPECT_FALSE(Process::Wait(id));
    processCalls = real;
    EXPECT_EQ(openHandles(), before);
    EXPECT_TRUE(Process::Wait(id));
}

TEST_F(ProcessFaultsPosix, an_end_that_is_not_allowed) {
    unsigned long const id = startEndless();
    processCalls.signalDescriptor = noSignal;
    EXPECT_FALSE(Process::Terminate(id));
    processCalls = real;
    EXPECT_TRUE(Process::Terminate(id));
    EXPECT_TRUE(Process::Wait(id));
}

TEST_F(ProcessFaultsPosix, interruptions_do_not_end_a_wait) {
    processCalls.awaitDescriptor = interruptedPoll;
    processCalls.waitFor = interruptedWait;
    interruptions = 3;
    EXPECT_EQ(shell("exit 3"), 3);
    EXPECT_LE(interruptions, 0);
    unsigned long const id = start("/bin/true");
    interruptions = 3;
    EXPECT_TRUE(Process::Wait(id));
    EXPECT_LE(interruptions, 0);
    EXPECT_FALSE(hasChildren());
}

TEST_F(ProcessFaultsPosix, a_system_without_descriptors_of_processes_knows_children) {
    processCalls.openProcess = noSuchCall;
    unsigned long const id = startEndless();
    EXPECT_TRUE(Process::Terminate(id));
    EXPECT_TRUE(Process::Wait(id));
    EXPECT_FALSE(hasChildren());
    EXPECT_FALSE(Process::Wait(id));
    EXPECT_FALSE(Process::Wait(1)) << "no child of ours";
    EXPECT_FALSE(Process::Terminate(id));
}
