/// \file
/// The texts among the arguments of a thread's last call of a function.
///
/// Their thread replaces them at each call, other threads seldom read them, and so the lock between them costs only its
/// readers: their thread sets a word and looks at another. A reader does so in the opposite order, with a barrier for
/// the whole process in between, and one of them sees the other. See wait/lock_word.h, which frees its word this way.

#ifndef HOST_XOS_BASICS_CONTROL_CALL_TEXTS_H
#define HOST_XOS_BASICS_CONTROL_CALL_TEXTS_H

#include "host/compiler.h"
#include "host/xos_basics/wait/process_barrier.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>

namespace host {

constexpr std::uint64_t NULL_TEXT = ~std::uint64_t{0};

class CallTexts {
public:
    /// Drops all texts. Waits for a reader.
    /// \thread their own
    HOST_INLINE void begin() {
        if (isReadAfterMark()) awaitReader();
        used_ = 0;
    }

    /// \pre `begin`, and not yet `end`
    /// \return the place of the copy; `NULL_TEXT` if `text` is null, and without memory
    /// \thread their own
    std::uint64_t add(char const* text);

    /// \thread their own
    HOST_INLINE void end() { isWritten_.store(false, std::memory_order_release); }

    /// Keeps the texts as they are. Works with `std::lock_guard`.
    /// \thread any
    void lock();
    void unlock();

    /// \pre `lock`, and not yet `unlock`
    /// \param place  other than `NULL_TEXT`
    char const* text(std::uint64_t place) const { return bytes_.get() + place; }

private:
    HOST_INLINE bool isReadAfterMark() {
        if (hasProcessBarrier) {
            isWritten_.store(true, std::memory_order_relaxed);
            std::atomic_signal_fence(std::memory_order_seq_cst);
        } else {
            isWritten_.exchange(true, std::memory_order_seq_cst);
        }
        return isRead_.load(std::memory_order_seq_cst);
    }
    HOST_COLD void awaitReader();
    HOST_COLD bool grow(std::size_t size);

    std::atomic<bool> isWritten_{false};
    std::atomic<bool> isRead_{false};
    /// Held by the reader.
    QuickMutex mutex_;
    /// Each text with its zero.
    std::unique_ptr<char[]> bytes_;
    std::size_t size_{0};
    std::size_t used_{0};
};

} // namespace host

#endif
