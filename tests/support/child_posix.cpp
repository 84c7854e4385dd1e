// The sibling is child_win.cpp.

#include "tests/support/child.h"

#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>

namespace {

[[noreturn]] void becomeChild(Child const& child, std::string const& program, int output) {
    for (auto const& [name, value] : child.environment) {
        if (value.empty()) {
            ::unsetenv(name.c_str());
        } else {
            ::setenv(name.c_str(), value.c_str(), 1);
        }
    }
    std::vector<char*> arguments{const_cast<char*>(program.c_str())};
    for (std::string const& argument : child.arguments) arguments.push_back(const_cast<char*>(argument.c_str()));
    arguments.push_back(nullptr);
    ::dup2(output, STDOUT_FILENO);
    if (!child.inputFile.empty()) ::dup2(::open(child.inputFile.c_str(), O_RDONLY), STDIN_FILENO);
    if (!child.errorFile.empty())
        ::dup2(::open(child.errorFile.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0666), STDERR_FILENO);
    if (child.folder.empty() || ::chdir(child.folder.c_str()) == 0) ::execv(program.c_str(), arguments.data());
    ::_exit(127);
}

} // namespace

std::string programBeside(std::string const& name) {
    return std::filesystem::read_symlink("/proc/self/exe").parent_path() / name;
}

ChildResult run(Child const& child) {
    std::string const program = programBeside(child.program);
    int ends[2];
    if (::pipe(ends) != 0) return {};
    pid_t const process = ::fork();
    if (process == 0) {
        ::close(ends[0]);
        becomeChild(child, program, ends[1]);
    }
    ::close(ends[1]);
    ChildResult result;
    char buffer[4096];
    for (ssize_t n; (n = ::read(ends[0], buffer, sizeof buffer)) > 0;) {
        result.output.append(buffer, static_cast<std::size_t>(n));
    }
    ::close(ends[0]);
    int status = 0;
    if (process > 0 && ::waitpid(process, &status, 0) == process && WIFEXITED(status))
        result.exitCode = WEXITSTATUS(status);
    return result;
}
