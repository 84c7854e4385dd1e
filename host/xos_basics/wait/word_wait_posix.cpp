// The sibling is word_wait_win.cpp.

#include "host/xos_basics/wait/word_wait.h"

#include <cerrno>
#include <linux/futex.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace host {

static_assert(sizeof(std::atomic<std::uint32_t>) == sizeof(std::uint32_t));

namespace {

/// A wait is part of no result, so the caller's last error stays.
void futex(std::atomic<std::uint32_t>& word, int operation, std::uint32_t value) {
    int const lastError = errno;
    syscall(SYS_futex, &word, operation | FUTEX_PRIVATE_FLAG, value, nullptr, nullptr, 0);
    errno = lastError;
}

} // namespace

void waitWhile(std::atomic<std::uint32_t>& word, std::uint32_t value) { futex(word, FUTEX_WAIT, value); }

void wakeOne(std::atomic<std::uint32_t>& word) { futex(word, FUTEX_WAKE, 1); }

} // namespace host
