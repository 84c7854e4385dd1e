// The sibling is process_barrier_win.cpp.

#include "host/xos_basics/wait/process_barrier.h"

#include <cerrno>
#include <linux/membarrier.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace host {

namespace {

bool membarrier(int command) {
    int const lastError = errno;
    bool const good = syscall(SYS_membarrier, command, 0, 0) == 0;
    errno = lastError;
    return good;
}

} // namespace

bool const hasProcessBarrier = membarrier(MEMBARRIER_CMD_REGISTER_PRIVATE_EXPEDITED);

void passProcessBarrier() { membarrier(MEMBARRIER_CMD_PRIVATE_EXPEDITED); }

} // namespace host
