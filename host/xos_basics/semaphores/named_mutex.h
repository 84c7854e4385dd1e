/// \file
/// The system's part of a mutex that processes share. Twins: named_mutex_posix.cpp (a locked file),
/// named_mutex_win.cpp (a kernel object). Both take over what a dead thread or process held.

#ifndef HOST_XOS_BASICS_SEMAPHORES_NAMED_MUTEX_H
#define HOST_XOS_BASICS_SEMAPHORES_NAMED_MUTEX_H

namespace host {

class NamedMutex;

/// Opens or makes the mutex `id` of the process's user, for the rest of the process's life.
/// \return null on failure, with the system's last error
NamedMutex* openNamed(int id);

/// Recursive.
/// \return 0 for success, else the last error is set
int takeNamed(NamedMutex& mutex);
int giveNamed(NamedMutex& mutex);

} // namespace host

#endif
