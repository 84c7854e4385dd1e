/// \file
/// What a system knows of a thread. Twins: thread_facts_posix.cpp, thread_facts_win.cpp.

#ifndef TESTS_SUPPORT_THREAD_FACTS_H
#define TESTS_SUPPORT_THREAD_FACTS_H

#include <cstddef>
#include <string>

std::string nameOfThisThread();

/// Of a task's name, so much is kept.
extern std::size_t const LONGEST_THREAD_NAME;

/// What the process holds open: descriptors or handles.
std::size_t openHandles();

#endif
