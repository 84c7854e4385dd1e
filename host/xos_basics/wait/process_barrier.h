/// \file
/// A memory barrier for all threads of the process. A thread that waits for long pays for it, so that a thread that
/// does not wait need not: one thread's barrier also keeps the order of a store and a later load in the others. Twins:
/// process_barrier_posix.cpp, process_barrier_win.cpp.

#ifndef HOST_XOS_BASICS_WAIT_PROCESS_BARRIER_H
#define HOST_XOS_BASICS_WAIT_PROCESS_BARRIER_H

namespace host {

/// Whether the system has such a barrier. False before the library's variables are initialised, then settled.
extern bool const hasProcessBarrier;

/// \pre there is one
void passProcessBarrier();

} // namespace host

#endif
