/// \file
/// The trace that XOS_TRACE asks for: one line for each call, written when the call returns.
///
///     2026-11-22T19:47:08.123456Z 1234/1240 xos_FileMove("new", "old", 1) = -1, error 2, 13.0 us
///
/// The trace is decided once, when the library is loaded. Without it a call costs nothing more: `call` finds the trace
/// by the word that it reads anyway, for the failures on demand.

#ifndef HOST_XOS_BASICS_CONTROL_TRACE_H
#define HOST_XOS_BASICS_CONTROL_TRACE_H

#include "host/xos_basics/control/functions.h"

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <string>

namespace host {

bool isTracing();

/// One call, from before it does anything until it returns. Leaves the last error as the call leaves it.
class TracedCall {
public:
    /// \param arguments  one word for each; for a text its address
    TracedCall(Function function, std::uint64_t const* arguments, std::size_t count);

    /// Writes the line.
    /// \param hasFailed  whether the line also says the last error, if the call has set one
    void end(std::uint64_t result, bool hasFailed);

private:
    Function function_;
    unsigned long errorBefore_;
    std::chrono::steady_clock::time_point begin_;
    /// What is known before the call; empty without memory, and then no line is written.
    std::string line_;
};

} // namespace host

#endif
