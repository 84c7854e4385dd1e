// The sibling is word_wait_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_basics/wait/word_wait.h"

#include <synchapi.h>

namespace host {

static_assert(sizeof(std::atomic<std::uint32_t>) == sizeof(std::uint32_t));

void waitWhile(std::atomic<std::uint32_t>& word, std::uint32_t value) {
    DWORD const lastError = GetLastError();
    WaitOnAddress(&word, &value, sizeof value, INFINITE);
    SetLastError(lastError);
}

void wakeOne(std::atomic<std::uint32_t>& word) { WakeByAddressSingle(&word); }

} // namespace host
