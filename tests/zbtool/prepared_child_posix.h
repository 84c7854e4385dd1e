/// \file
/// Starts a program in a process that is prepared first: another user, limits, a place of its own for a small disk.

#ifndef TESTS_ZBTOOL_PREPARED_CHILD_POSIX_H
#define TESTS_ZBTOOL_PREPARED_CHILD_POSIX_H

#include "tests/support/child.h"
#include "tests/support/scratch.h"

#include <fcntl.h>
#include <string>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

class PreparedChild {
public:
    struct End {
        int code = -1; ///< -1: ended by a signal
        int signal = 0;
        std::string output;
        std::string errors;
    };

    /// \param prepare  runs in the new process; false ends it with code 126
    template <class Prepare>
    PreparedChild(std::vector<std::string> const& words, std::string const& folder, Prepare prepare) {
        process_ = ::fork();
        if (process_ != 0) return;
        redirect(STDOUT_FILENO, streams_ / "output");
        redirect(STDERR_FILENO, streams_ / "errors");
        std::vector<char*> arguments;
        for (std::string const& word : words) arguments.push_back(const_cast<char*>(word.c_str()));
        arguments.push_back(nullptr);
        if (::chdir(folder.c_str()) != 0 || !prepare()) ::_exit(126);
        ::execvp(arguments[0], arguments.data());
        ::_exit(127);
    }

    pid_t process() const { return process_; }

    End wait() {
        int status = 0;
        if (::waitpid(process_, &status, 0) != process_) return {};
        End end{-1, 0, textOf(streams_ / "output"), textOf(streams_ / "errors")};
        if (WIFEXITED(status)) end.code = WEXITSTATUS(status);
        if (WIFSIGNALED(status)) end.signal = WTERMSIG(status);
        return end;
    }

private:
    static void redirect(int stream, std::string const& file) {
        ::dup2(::open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0666), stream);
    }

    Scratch streams_;
    pid_t process_;
};

inline std::string const ZBTOOL = programBeside("zbtool");

inline constexpr uid_t NOBODY = 65534;

/// Gives up root's rights; any other user's are as few already.
inline bool becomeNobody() {
    return ::geteuid() != 0 || (::setresgid(NOBODY, NOBODY, NOBODY) == 0 && ::setresuid(NOBODY, NOBODY, NOBODY) == 0);
}

inline bool nobodyMayRun() { return PreparedChild({ZBTOOL, "--help"}, "/", becomeNobody).wait().code == 0; }

#endif
