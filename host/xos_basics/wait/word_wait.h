/// \file
/// Sleeping on a word in memory until another thread changes it, the system's part of every lock here.
/// Twins: word_wait_posix.cpp (futex), word_wait_win.cpp (WaitOnAddress).

#ifndef HOST_XOS_BASICS_WAIT_WORD_WAIT_H
#define HOST_XOS_BASICS_WAIT_WORD_WAIT_H

#include <atomic>
#include <cstdint>

namespace host {

/// Sleeps while the word has the value; may also return for no reason.
void waitWhile(std::atomic<std::uint32_t>& word, std::uint32_t value);

/// The word need not exist any more: an address at which no thread waits is not an error.
void wakeOne(std::atomic<std::uint32_t>& word);

} // namespace host

#endif
