/// \file
/// The files that all processes of a user share while the system runs. For `_posix` sources only.

#ifndef HOST_XOS_BASICS_SEMAPHORES_RUN_FILE_POSIX_H
#define HOST_XOS_BASICS_SEMAPHORES_RUN_FILE_POSIX_H

#include <span>
#include <string>

namespace host {

/// Opens a file in the user's run directory, and makes both where they are missing. The directory lies in the first of
/// the parents that serves: one in which it can be made, belongs to the user alone, and can be written.
/// \return its descriptor; -1: failed, and errno says why
int openRunFile(std::span<char const* const> parents, std::string const& name);

} // namespace host

#endif
