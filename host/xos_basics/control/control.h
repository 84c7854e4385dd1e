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

#include "host/xos_basics/control/call_order.h"
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

/// Notes one call in the calling thread's record, from construction to destruction.
class CallNote {
public:
    /// \param isAlike  says that all calls of the function have the same record, so the last one need not be known
    [[gnu::always_inline]] explicit CallNote(Function function, bool isAlike = false)
        : CallNote(function, isAlike, threadCalls()) {}
    CallNote(CallNote const&) = delete;
    CallNote& operator=(CallNote const&) = delete;
    ~CallNote() { record_.completed.store(number_, std::memory_order_release); }

    void addWord(std::uint64_t word) { slot_.words[arguments_++].store(word, std::memory_order_release); }

    void addText(char const* text) { addWord(keepText(slot_, text, textWords_)); }

    template <class Argument>
    void add(Argument const& argument) {
        if constexpr (std::is_same_v<Argument, char const*>) {
            addText(argument);
        } else if constexpr (std::is_pointer_v<Argument>) {
            addWord(reinterpret_cast<std::uintptr_t>(argument));
        } else {
            static_assert(std::is_integral_v<Argument>);
            // Signed numbers keep their sign in 64 bits.
            addWord(static_cast<std::uint64_t>(static_cast<std::int64_t>(argument)));
        }
    }

private:
    [[gnu::always_inline]] CallNote(Function function, bool isAlike, ThreadCalls& mine)
        : record_(mine.records[indexOf(function)]),
          number_(record_.completed.load(std::memory_order_relaxed) + 1),
          slot_(record_.slots[number_ % 2]) {
        slot_.stamp.store(isAlike ? 0 : stampOfCall(function, mine), std::memory_order_release);
    }

    CallRecord& record_;
    std::uint64_t const number_;
    CallSlot& slot_;
    std::size_t arguments_{0};
    std::size_t textWords_{0};
};

inline bool failsAfterNote(Function function) {
    return armedFaults.load(std::memory_order_relaxed) != 0 && takesInjectedFailure(function);
}

/// Inlined everywhere: with the function known, half of it folds away.
template <class... Arguments>
[[gnu::always_inline]] inline bool failsNow(Function function, Arguments const&... arguments) {
    static_assert(sizeof...(Arguments) <= MAX_ARGUMENTS);
    {
        CallNote note{function, sizeof...(Arguments) == 0};
        (note.add(arguments), ...);
    }
    return failsAfterNote(function);
}

} // namespace host

#endif
