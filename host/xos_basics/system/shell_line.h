/// \file
/// The one command-interpreter form that callers build: `cd DIRECTORY& COMMAND`.

#ifndef HOST_XOS_BASICS_SYSTEM_SHELL_LINE_H
#define HOST_XOS_BASICS_SYSTEM_SHELL_LINE_H

#include <string>
#include <string_view>

namespace host {

struct ShellLine {
    /// As it is written, with slashes of either kind, without double quotes around it; empty: stay where we are.
    std::string directory;
    /// What the interpreter runs there; everything when the line is not of that form.
    std::string command;
};

/// The line is of that form when it begins with "cd " and has an "& " behind it. The first one ends the directory.
ShellLine splitShellLine(std::string_view line);

} // namespace host

#endif
