/// \file
/// How the modules beside xos_basics reach its control functions: at run time, by name. Where the server's own
/// xos_basics is loaded there are none, and the modules do without: nothing is counted and nothing fails on demand.
/// Twins: find_control_posix.cpp, find_control_win.cpp.

#ifndef HOST_CONTROL_LINK_CONTROL_LINK_H
#define HOST_CONTROL_LINK_CONTROL_LINK_H

#include <cstdint>
#include <initializer_list>

namespace host {

/// The address of a function of the loaded xos_basics; null when it has none of that name.
void* findControl(char const* name);

/// Counts a call and remembers its arguments, texts by their address.
/// \return whether the call is to fail; the last
///     error is then set
bool failsNow(char const* function, std::initializer_list<std::uint64_t> arguments);

/// Says how `xos_HostAlertFire` runs an alert.
void offerAlertFire(int (*fire)(std::uint32_t id));

inline std::uint64_t addressArgument(void const* address) { return reinterpret_cast<std::uintptr_t>(address); }

} // namespace host

#endif
