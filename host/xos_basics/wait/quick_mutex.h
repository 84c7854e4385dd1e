/// \file
/// The host's own lock: eight bytes, initialised before any code runs and never destroyed, uncontended in user space.
/// Works with `std::lock_guard`.

#ifndef HOST_XOS_BASICS_WAIT_QUICK_MUTEX_H
#define HOST_XOS_BASICS_WAIT_QUICK_MUTEX_H

#include "host/xos_basics/wait/lock_word.h"

namespace host {

class QuickMutex {
public:
    constexpr QuickMutex() = default;
    QuickMutex(QuickMutex const&) = delete;
    QuickMutex& operator=(QuickMutex const&) = delete;

    void lock() { takeWord(lock_); }
    void unlock() { giveWord(lock_); }

private:
    LockWord lock_;
};

} // namespace host

#endif
