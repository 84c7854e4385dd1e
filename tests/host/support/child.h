/// \file
/// A helper process of a test. Twins: child_posix.cpp, child_win.cpp.

#ifndef TESTS_HOST_SUPPORT_CHILD_H
#define TESTS_HOST_SUPPORT_CHILD_H

#include <cstdint>
#include <string>
#include <utility>
#include <vector>

using Words = std::vector<std::string>;
/// Variables for the child, beside those of this process.
using Environment = std::vector<std::pair<std::string, std::string>>;

class Child {
public:
    /// \param program  a file's path, with its suffix
    Child(std::string const& program, Words const& arguments, Environment const& environment = {});
    Child(Child const&) = delete;
    Child& operator=(Child const&) = delete;
    /// Ends a child that still runs.
    ~Child();

    bool isStarted() const { return process_ != 0; }
    /// Ends it without giving it a chance to clean up.
    void kill();
    /// \return the exit code; -1 when it has not ended within 30 s, or was killed
    int wait();

private:
    std::int64_t process_{0};
};

/// The path of a program that was built beside this one.
std::string programBeside(std::string const& name);

/// The folder in which the shared libraries were built, and how they are called.
std::string libraryFile(std::string const& name);

/// The most memory that this process has held at a time, in bytes.
std::uint64_t peakMemory();

/// Sets a variable of this process; empty removes it.
void setVariable(std::string const& name, std::string const& value);

#endif
