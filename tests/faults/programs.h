/// \file
/// A program of the system that succeeds. Twins: programs_posix.cpp, programs_win.cpp.

#ifndef TESTS_FAULTS_PROGRAMS_H
#define TESTS_FAULTS_PROGRAMS_H

struct Program {
    char const* file;
    char const* commandLine;
};

extern Program const SUCCEEDING;

/// Waits for a process that was started a moment ago.
bool isAwaited(unsigned long processId);

#endif
