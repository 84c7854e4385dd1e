/// \file
/// Loading a shared library. Twins: library_posix.cpp, library_win.cpp.

#ifndef HOST_XOS_BASICS_SYSTEM_LIBRARY_H
#define HOST_XOS_BASICS_SYSTEM_LIBRARY_H

namespace host {

/// \return the system's handle of the library, for the process's life; null when there is none, the last error is then
///     set
void* loadLibrary(char const* name);

} // namespace host

#endif
