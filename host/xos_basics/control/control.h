/// \file
/// What every platform function does first: count the call, remember its arguments, and ask whether it is to fail.
///
///     if (failsNow(Function::xos_FileMove, dst, src, overwrite)) {
///         return FAILED;
///     }
///
/// Always on, correct from any thread, about a nanosecond. The arguments are given in the order and number of the
/// function's kinds in functions.h. A `char const*` is a text, which is copied; any other pointer is an address.

#ifndef HOST_XOS_BASICS_CONTROL_CONTROL_H
#define HOST_XOS_BASICS_CONTROL_CONTROL_H

#include "host/xos_basics/control/call_record.h"
#include "host/xos_basics/control/functions.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <type_traits>

namespace host {

/// The result of an `int` function that fails without a more telling value.
constexpr int FAILED = -1;

/// How many functions are to fail now or later.
extern constinit std::atomic<std::uint32_t> armedFaults;

/// Whether this call of the function is to fail; the last error is then set.
bool takesInjectedFailure(Function function);

template <class Argument>
std::uint64_t argumentWord(CallRecord& record, Argument const& argument, std::size_t& textWords) {
    if constexpr (std::is_same_v<Argument, char const*>) {
        return keepText(record, argument, textWords);
    } else if constexpr (std::is_pointer_v<Argument>) {
        return reinterpret_cast<std::uintptr_t>(argument);
    } else {
        static_assert(std::is_integral_v<Argument>);
        // Signed numbers keep their sign in 64 bits.
        return static_cast<std::uint64_t>(static_cast<std::int64_t>(argument));
    }
}

template <class... Arguments>
bool failsNow(Function function, Arguments const&... arguments) {
    static_assert(sizeof...(Arguments) <= MAX_ARGUMENTS);
    ThreadCalls& mine = threadCalls();
    CallRecord& record = mine.records[indexOf(function)];
    std::uint64_t const sequence = record.sequence.load(std::memory_order_relaxed);
    record.sequence.store(sequence + 1, std::memory_order_relaxed);
    bool const alone = soleCaller[indexOf(function)].load(std::memory_order_relaxed) == &mine;
    record.stamp.store(alone ? 0 : stampOfSharedCall(function, mine), std::memory_order_release);
    [[maybe_unused]] std::size_t textWords = 0;
    [[maybe_unused]] std::size_t index = 0;
    (record.words[index++].store(argumentWord(record, arguments, textWords), std::memory_order_release), ...);
    record.sequence.store(sequence + 2, std::memory_order_release);
    return armedFaults.load(std::memory_order_relaxed) != 0 && takesInjectedFailure(function);
}

} // namespace host

#endif
