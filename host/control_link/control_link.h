/// \file
/// How the other modules reach the control functions of xos_basics: at run time, by name. The server's own xos_basics
/// has none; then nothing is counted and nothing fails on demand. Twins: find_control_posix.cpp, find_control_win.cpp.

#ifndef HOST_CONTROL_LINK_CONTROL_LINK_H
#define HOST_CONTROL_LINK_CONTROL_LINK_H

#include <cstdint>
#include <initializer_list>

namespace host {

/// Finds a function of the loaded xos_basics.
/// \return its address; null if there is none of that name
void* findControl(char const* name);

/// Counts a call and stores its arguments; a text is passed by its address.
/// \return whether the call must fail; the last error is then set
bool failsNow(char const* function, std::initializer_list<std::uint64_t> arguments);

/// Sets the function by which `xos_HostAlertFire` runs an alert.
void offerAlertFire(int (*fire)(std::uint32_t id));

inline std::uint64_t addressArgument(void const* address) { return reinterpret_cast<std::uintptr_t>(address); }

} // namespace host

#endif
