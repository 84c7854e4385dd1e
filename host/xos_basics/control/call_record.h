/// \file
/// What one thread remembers of its last call of each function, readable by others while it is written.
///
/// Each thread writes its own records with plain stores: no two threads write one cache line and no instruction locks
/// the bus. A record has two slots, which calls use in turn, so that the last call stands still while the next one is
/// noted, however long that takes. A reader begins anew when the next one has been completed meanwhile. Every store of
/// a payload releases and every load of it acquires, so a reader that sees anything of a call also sees all calls
/// before it completed.
///
/// Records outlive their thread: the next new thread takes them over and counts on. Nothing a reader looks at is ever
/// freed.

#ifndef HOST_XOS_BASICS_CONTROL_CALL_RECORD_H
#define HOST_XOS_BASICS_CONTROL_CALL_RECORD_H

#include "host/xos_basics/control/functions.h"

#include <array>
#include <atomic>
#include <cstddef>
#include <cstdint>
#include <string>

namespace host {

/// Bytes of the text arguments, eight to a word. A full buffer is replaced by a larger one and kept for late readers.
struct TextBuffer {
    TextBuffer* older;
    std::size_t words;
    std::atomic<std::uint64_t>* data;
};

struct CallSlot {
    std::array<std::atomic<std::uint64_t>, MAX_ARGUMENTS> words;
    /// When the call was made; 0 where one thread alone calls the function, unless events order its calls,
    /// and where it has no arguments.
    std::atomic<std::uint64_t> stamp;
    std::atomic<TextBuffer*> texts;
    /// How many words of the texts the call uses.
    std::atomic<std::uint64_t> textWords;
};

struct CallRecord {
    /// How many calls have been noted.
    std::atomic<std::uint64_t> completed;
    /// The call that has number n, from 1 on, is in slot n modulo 2.
    std::array<CallSlot, 2> slots;
};

struct Semaphore;

/// The records of one thread, and what else it keeps for itself.
struct ThreadCalls {
    /// Of the thread that uses the records now; never given twice. 0: shared by threads without memory for their own.
    std::uint64_t threadSerial;
    /// The thread's time as call_order.h counts it.
    std::atomic<std::uint64_t> time;
    std::array<CallRecord, FUNCTION_COUNT> records;
    /// How many calls had been noted at the last reset. Under the registry's mutex, as are `next` and `inUse`.
    std::array<std::uint64_t, FUNCTION_COUNT> completedAtReset;
    /// The thread's store of semaphore blocks.
    Semaphore* freeSemaphores;
    std::uint32_t freeSemaphoreCount;
    /// Mutexes that the thread holds; see tasks/deferred_threads.h.
    std::uint32_t heldMutexes;
    bool hasDeferredThreads;
    ThreadCalls* next;
    bool inUse;
    /// The text that `xos_HostLastCall` handed to this thread; null before.
    std::string* lastCallText;
};

/// The calling thread's records; null before its first call and while it ends.
extern constinit thread_local ThreadCalls* currentThreadCalls;

/// Shared by the threads for which no memory was left, and the mark of a function that several threads have called.
extern constinit ThreadCalls spareThreadCalls;

/// Gives the calling thread its records.
ThreadCalls* adoptThreadCalls();

/// The only thread that has called a function so far; a value that is no thread's once there are several. Not kept for
/// functions whose calls are ordered by events.
extern constinit std::array<std::atomic<ThreadCalls*>, FUNCTION_COUNT> soleCaller;

inline ThreadCalls& threadCalls() {
    ThreadCalls* const mine = currentThreadCalls;
    return mine != nullptr ? *mine : *adoptThreadCalls();
}

/// Copies a text argument behind the `used` words of texts already in the slot. \return the argument's word
std::uint64_t keepText(CallSlot& slot, char const* text, std::size_t& used);

/// The word of a null text.
constexpr std::uint64_t NULL_TEXT = ~std::uint64_t{0};

} // namespace host

#endif
