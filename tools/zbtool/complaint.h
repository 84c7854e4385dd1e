/// \file
/// How errors are told: one line on standard error that names a path and the reason.

#ifndef TOOLS_ZBTOOL_COMPLAINT_H
#define TOOLS_ZBTOOL_COMPLAINT_H

#include <string>
#include <string_view>

namespace zbtool {

/// Returns why the calling thread's last call failed, in the system's words. reason_posix.cpp, reason_win.cpp.
std::string lastReason();

/// Tells whether the calling thread's last call failed because a rename does not reach another file system.
bool lastFailureNeedsCopy();

/// Prints "zbtool: SUBJECT: REASON" in one line, whatever names are in it. Silent once an interruption is wanted, which
/// makes calls fail by itself.
/// \return false, so that a failing function can return it
/// \thread thread-safe
bool complain(std::string_view subject, std::string_view reason);
/// The same with the reason of the last call.
bool complain(std::string_view subject);

} // namespace zbtool

#endif
