/// \file
/// Runs a program of the test folder in a process of its own, with an environment and a folder of its own.
/// child_posix.cpp, child_win.cpp.

#ifndef TESTS_SUPPORT_CHILD_H
#define TESTS_SUPPORT_CHILD_H

#include <string>
#include <utility>
#include <vector>

struct Child {
    /// The name of a program beside the running one, without suffix.
    std::string program;
    std::vector<std::string> arguments;
    /// Variables to set; an empty value removes one.
    std::vector<std::pair<std::string, std::string>> environment;
    /// Where it starts; empty: here.
    std::string folder;
    /// What its standard input reads; empty: the same as this process's.
    std::string inputFile = {};
    /// Receives its standard error; empty: it goes where this process's goes.
    std::string errorFile = {};
};

struct ChildResult {
    /// -1 if it did not start or did not end by itself.
    int exitCode = -1;
    /// What it printed on standard output, with "\n" as line end.
    std::string output;
};

ChildResult run(Child const& child);

/// The path of a program beside the running one.
/// \param name  without suffix
std::string programBeside(std::string const& name);

#endif
