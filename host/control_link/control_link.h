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

/// The arguments of a call, one word for each; a text is passed by its address.
using Arguments = std::initializer_list<std::uint64_t>;

/// Counts a call and stores its arguments.
/// \return whether the call must fail; the last error is then set
bool failsNow(char const* function, Arguments arguments);

/// \return what `endTrace` takes; null without a trace
void* beginTrace(char const* function, Arguments arguments);
void endTrace(void* traced, std::uint64_t result, bool hasFailed);

/// Runs `body` as one call of a platform function, which is counted, may fail on demand and may be traced.
template <class Result, class Body>
Result call(char const* function, Arguments arguments, Result failure, Body body) {
    void* const traced = beginTrace(function, arguments);
    Result const result = failsNow(function, arguments) ? failure : body();
    endTrace(traced, static_cast<std::uint64_t>(static_cast<std::int64_t>(result)), result == failure);
    return result;
}

/// Sets the function by which `xos_HostAlertFire` runs an alert.
void offerAlertFire(int (*fire)(std::uint32_t id));

inline std::uint64_t addressArgument(void const* address) { return reinterpret_cast<std::uintptr_t>(address); }

} // namespace host

#endif
