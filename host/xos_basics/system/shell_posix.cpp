// The sibling is shell_win.cpp.

#include "host/xos_basics/system/shell.h"
#include "host/xos_basics/system/shell_line.h"
#include "host/xos_basics/tasks/task_pool.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdlib>
#include <spawn.h>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

namespace host {

namespace {

std::string quoted(std::string const& text) {
    std::string result = "'";
    for (char const c : text) { result += c == '\'' ? std::string("'\\''") : std::string(1, c); }
    return result + "'";
}

/// The directory is taken as it stands: no search path, no "-" for the last one, either slash.
std::string changeDirectory(std::string directory) {
    std::replace(directory.begin(), directory.end(), '\\', '/');
    if (directory.front() != '/') directory.insert(0, "./");
    return "CDPATH= cd -- " + quoted(directory) + " || exit\n";
}

std::string scriptOf(ShellLine const& line) {
    return line.directory.empty() ? line.command : changeDirectory(line.directory) + line.command;
}

/// The child gets the three standard descriptors and no blocked signals.
int spawnShell(std::string script, pid_t& child) {
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addclosefrom_np(&actions, STDERR_FILENO + 1);
    posix_spawnattr_t attributes;
    posix_spawnattr_init(&attributes);
    sigset_t none;
    sigemptyset(&none);
    posix_spawnattr_setsigmask(&attributes, &none);
    posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSIGMASK);
    char name[] = "sh";
    char option[] = "-c";
    char end[] = "--";
    char* const arguments[] = {name, option, end, script.data(), nullptr};
    int const error = posix_spawn(&child, "/bin/sh", &actions, &attributes, arguments, environ);
    posix_spawnattr_destroy(&attributes);
    posix_spawn_file_actions_destroy(&actions);
    return error;
}

/// A process that ignores its children's ends learns no exit code; the command has run all the same.
constexpr std::int64_t UNKNOWN_CODE = -1;
constexpr std::int64_t SIGNALLED = 128;

std::int64_t waitForChild(pid_t child) {
    int status = 0;
    while (waitpid(child, &status, 0) < 0) {
        if (errno != EINTR) return UNKNOWN_CODE;
    }
    return WIFSIGNALED(status) ? SIGNALLED + WTERMSIG(status) : WEXITSTATUS(status);
}

void reap(void* child) { waitForChild(static_cast<pid_t>(reinterpret_cast<std::intptr_t>(child))); }

/// Somebody has to take note of the child's end, or it stays in the process table.
void reapLater(pid_t child) {
    xos_TaskParams params{};
    params.entry = reap;
    params.argument = reinterpret_cast<void*>(static_cast<std::intptr_t>(child));
    params.name = "xos_shell";
    runTask(jobOf(params));
}

} // namespace

bool runInShell(char const* commandLine, std::int64_t* exitCode) {
    pid_t child = 0;
    int const error = spawnShell(scriptOf(splitShellLine(commandLine)), child);
    if (error != 0) {
        errno = error;
        return false;
    }
    if (exitCode != nullptr) {
        *exitCode = waitForChild(child);
    } else {
        reapLater(child);
    }
    return true;
}

} // namespace host
