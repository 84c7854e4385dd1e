/// \file
/// The command interpreter. Twins: shell_posix.cpp, shell_win.cpp.

#ifndef HOST_XOS_BASICS_SYSTEM_SHELL_H
#define HOST_XOS_BASICS_SYSTEM_SHELL_H

#include <cstdint>

namespace host {

/// Starts the interpreter on a command line and, with an `exitCode`, waits for it.
/// \return false: it could not be started, or not be waited for; the last error says why
bool runInShell(char const* commandLine, std::int64_t* exitCode);

} // namespace host

#endif
