/// \file
/// What surrounds the body of every platform function: the call is counted, its arguments are remembered, it fails if
/// that was asked for, and it is traced if XOS_TRACE asks for that.
///
///     return call(Function::xos_FileFlush, FAILED, [=] { return flush(handle); }, handle);
///
/// Always on, correct from any thread; takes about a nanosecond, and four for each text. The arguments are given in the
/// order and number of the function's kinds in functions.h. A `char const*` is a text, which is copied; any other
/// pointer is an address.
///
/// A thread stores its calls in its own records. The sequence number of a record is odd while its words are written; a
/// reader that finds it odd or changed starts again. Every store of a word releases and every load of it acquires, so a
/// reader that sees anything of a later call also sees its sequence number. Texts have a lock, see call_texts.h.
///
/// Which thread called a function last is a word that all threads share, written only when another thread calls. For
/// quick functions even that would cost too much: each thread writes it once in each era. An era ends when a thread or
/// task begins or ends, when a last call is queried and when the calls are reset.

#ifndef HOST_XOS_BASICS_CONTROL_CONTROL_H
#define HOST_XOS_BASICS_CONTROL_CONTROL_H

#include "host/compiler.h"
#include "host/xos_basics/control/call_texts.h"
#include "host/xos_basics/control/faults.h"
#include "host/xos_basics/control/functions.h"
#include "host/xos_basics/control/trace.h"
#include "host/xos_basics/this_thread.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>
#include <string>
#include <type_traits>

namespace host {

constexpr int NEVER_FAILS = 0;

struct CallRecord {
    void addWord(std::size_t argument, std::uint64_t word) { words[argument].store(word, std::memory_order_release); }
    /// Copies the text. Without memory for it, it is noted as null.
    void addText(std::size_t argument, char const* text) { addWord(argument, texts.add(text)); }

    /// Twice the number of calls, plus one while a call is being written.
    std::atomic<std::uint64_t> sequence;
    /// The arguments; for a text its place in `texts`, or `NULL_TEXT`.
    std::array<std::atomic<std::uint64_t>, MAX_ARGUMENTS> words;
    /// The era of a quick function's last call. Its thread's alone.
    std::uint64_t era;
    /// How many calls there were at the last reset. Guarded by the registry's mutex.
    std::uint64_t callsAtReset;
    CallTexts texts;
};

/// Outlives its thread: the next new thread takes it over and counts on.
struct ThreadCalls {
    std::array<CallRecord, FUNCTION_COUNT> records;
    /// What `xos_HostLastCall` returned to this thread.
    std::string lastCallText;
    /// These two are guarded by the registry's mutex.
    ThreadCalls* next;
    bool inUse;
};

struct CallRegistry {
    QuickMutex mutex;
    /// Of all threads, living and dead.
    ThreadCalls* first{nullptr};
    std::array<std::atomic<ThreadCalls*>, FUNCTION_COUNT> lastCaller{};
    /// Read at every quick call and rarely written, so it has a cache line of its own.
    alignas(64) std::atomic<std::uint64_t> era{1};
};

extern constinit CallRegistry registry;

inline void beginEra() { registry.era.fetch_add(1, std::memory_order_relaxed); }

/// \return null without memory: such a thread's calls are not recorded
ThreadCalls* adoptThreadCalls();

inline ThreadCalls* threadCalls() { return thisThread.calls != nullptr ? thisThread.calls : adoptThreadCalls(); }

/// \return the sequence number for `endCall`
HOST_INLINE std::uint64_t beginCall(Function function, CallRecord& record) {
    if (factsOf(function).hasTexts) record.texts.begin();
    std::uint64_t const begun = record.sequence.load(std::memory_order_relaxed) + 1;
    record.sequence.store(begun, std::memory_order_relaxed);
    return begun;
}

/// Signed numbers keep their sign in 64 bits; a text is its address.
template <class Argument>
HOST_INLINE std::uint64_t wordOf(Argument const& argument) {
    if constexpr (std::is_pointer_v<Argument>) {
        return reinterpret_cast<std::uintptr_t>(argument);
    } else {
        static_assert(std::is_integral_v<Argument>);
        return static_cast<std::uint64_t>(static_cast<std::int64_t>(argument));
    }
}

template <class Argument>
HOST_INLINE void noteArgument(CallRecord& record, std::size_t index, Argument const& argument) {
    if constexpr (std::is_same_v<Argument, char const*>) {
        record.addText(index, argument);
    } else {
        record.addWord(index, wordOf(argument));
    }
}

HOST_INLINE void endCall(Function function, CallRecord& record, ThreadCalls& mine, std::uint64_t begun) {
    record.sequence.store(begun + 1, std::memory_order_release);
    if (factsOf(function).hasTexts) record.texts.end();
    std::atomic<ThreadCalls*>& last = registry.lastCaller[indexOf(function)];
    bool const isQuick = (factsOf(function).traits & IS_QUICK) != 0;
    std::uint64_t const era = isQuick ? registry.era.load(std::memory_order_relaxed) : 0;
    if (isQuick ? record.era == era : last.load(std::memory_order_relaxed) == &mine) return;
    record.era = era;
    last.store(&mine, std::memory_order_release);
}

template <class... Arguments>
HOST_INLINE void recordCall(Function function, Arguments const&... arguments) {
    static_assert(sizeof...(Arguments) <= MAX_ARGUMENTS);
    ThreadCalls* const mine = threadCalls();
    if (mine == nullptr) return;
    CallRecord& record = mine->records[indexOf(function)];
    std::uint64_t const begun = beginCall(function, record);
    std::size_t index = 0;
    (noteArgument(record, index++, arguments), ...);
    endCall(function, record, *mine, begun);
}

/// The body of a function that may have to fail, or is traced. Takes copies, as what is in registers otherwise would
/// have to be in memory at every call.
template <class Result, class Body, class... Arguments>
HOST_COLD Result callWatched(Function function, Result failure, Body body, Arguments... arguments) {
    if (!isTracing()) return takesInjectedFailure(function) ? failure : body();
    std::array<std::uint64_t, sizeof...(Arguments)> const words{wordOf(arguments)...};
    TracedCall traced{function, words.data(), words.size()};
    Result const result = takesInjectedFailure(function) ? failure : body();
    traced.end(wordOf(result), result == failure);
    return result;
}

/// \param failure  is what the function returns when it fails on demand; `NEVER_FAILS` if it cannot
/// \param body  does the function's work; for one that returns nothing it returns `NEVER_FAILS`
template <class Result, class Body, class... Arguments>
HOST_INLINE Result call(Function function, Result failure, Body const& body, Arguments const&... arguments) {
    recordCall(function, arguments...);
    if (isWatched(function)) return callWatched<Result, Body, Arguments...>(function, failure, body, arguments...);
    return body();
}

} // namespace host

#endif
