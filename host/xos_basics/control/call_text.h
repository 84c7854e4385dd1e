/// \file
/// The arguments of one call as text.

#ifndef HOST_XOS_BASICS_CONTROL_CALL_TEXT_H
#define HOST_XOS_BASICS_CONTROL_CALL_TEXT_H

#include "host/xos_basics/control/functions.h"

#include <array>
#include <cstdint>
#include <string>
#include <vector>

namespace host {

/// A copy of one call's arguments. A text argument's word counts the eight-byte words of `texts` before it.
struct CallSnapshot {
    std::array<std::uint64_t, MAX_ARGUMENTS> words;
    std::vector<std::uint64_t> texts;
};

/// Formats the arguments as `xos_HostLastCall` documents it. \param kinds  those of functions.h
std::string callText(char const* kinds, CallSnapshot const& call);

} // namespace host

#endif
