/// \file
/// Runs the program on a terminal of its own.

#ifndef TESTS_ZBTOOL_ON_TERMINAL_POSIX_H
#define TESTS_ZBTOOL_ON_TERMINAL_POSIX_H

#include "tests/zbtool/tool.h"

#include <pty.h>
#include <sys/wait.h>
#include <unistd.h>

/// \param typed  is what the user types
inline ToolResult runOnTerminal(std::string const& folder, std::vector<std::string> const& words,
                                std::string const& typed) {
    int terminal = -1;
    pid_t const process = ::forkpty(&terminal, nullptr, nullptr, nullptr);
    if (process == 0) {
        std::string const program = programBeside("zbtool");
        std::vector<char*> arguments{const_cast<char*>(program.c_str())};
        for (std::string const& word : words) arguments.push_back(const_cast<char*>(word.c_str()));
        arguments.push_back(nullptr);
        if (::chdir(folder.c_str()) == 0) ::execv(program.c_str(), arguments.data());
        ::_exit(127);
    }
    ToolResult result;
    if (::write(terminal, typed.data(), typed.size()) < 0) return result;
    char buffer[4096];
    for (ssize_t n = 0; (n = ::read(terminal, buffer, sizeof buffer)) > 0;)
        result.output.append(buffer, static_cast<std::size_t>(n));
    ::close(terminal);
    int status = 0;
    if (::waitpid(process, &status, 0) == process && WIFEXITED(status)) result.code = WEXITSTATUS(status);
    return result;
}

#endif
