#include "tests/host/xos_basics/files/failing_calls_posix.h"

#include <cerrno>
#include <cstring>
#include <dlfcn.h>
#include <sys/stat.h>
#include <unistd.h>

namespace {

/// The one that came to exist last.
FailingCall* newest = nullptr;

template <class Function>
Function systems(Function, char const* name) {
    return reinterpret_cast<Function>(::dlsym(RTLD_NEXT, name));
}

} // namespace

FailingCall::FailingCall(char const* name, int error, int skip, int times)
    : name_(name), error_(error), skip_(skip), times_(times), former_(newest) {
    newest = this;
}
FailingCall::~FailingCall() { newest = former_; }

bool FailingCall::failsNow(char const* name) {
    for (FailingCall* call = newest; call != nullptr; call = call->former_) {
        if (std::strcmp(call->name_, name) != 0) continue;
        if (call->skip_-- > 0 || call->times_-- <= 0) return false;
        call->hasFailed_ = true;
        errno = call->error_;
        return true;
    }
    return false;
}

mode_t permissionsBeforeChange = 0;

/// A function that fails on demand and otherwise does what the system's does.
#define STANDS_IN(Result, name, parameters, arguments, attributes)                                                     \
    extern "C" [[gnu::visibility("default")]] Result name parameters attributes {                                      \
        static auto const real = systems(&name, #name);                                                                \
        return FailingCall::failsNow(#name) ? -1 : real arguments;                                                     \
    }

STANDS_IN(ssize_t, copy_file_range, (int from, off64_t* a, int to, off64_t* b, std::size_t n, unsigned flags),
          (from, a, to, b, n, flags), )
STANDS_IN(ssize_t, read, (int file, void* to, std::size_t n), (file, to, n), )
STANDS_IN(ssize_t, write, (int file, void const* from, std::size_t n), (file, from, n), )
STANDS_IN(off_t, lseek, (int file, off_t offset, int origin), (file, offset, origin), noexcept)
STANDS_IN(int, ftruncate, (int file, off_t size), (file, size), noexcept)
STANDS_IN(int, futimens, (int file, timespec const times[2]), (file, times), noexcept)
STANDS_IN(int, mkdirat, (int at, char const* name, mode_t mode), (at, name, mode), noexcept)
STANDS_IN(int, linkat, (int from, char const* name, int to, char const* other, int flags),
          (from, name, to, other, flags), noexcept)
STANDS_IN(int, unlinkat, (int at, char const* name, int flags), (at, name, flags), noexcept)
STANDS_IN(int, renameat, (int from, char const* name, int to, char const* other), (from, name, to, other), noexcept)
STANDS_IN(int, renameat2, (int from, char const* name, int to, char const* other, unsigned flags),
          (from, name, to, other, flags), noexcept)

extern "C" [[gnu::visibility("default")]] int fchmod(int file, mode_t mode) noexcept {
    static auto const real = systems(&fchmod, "fchmod");
    struct stat status {};
    if (::fstat(file, &status) == 0) permissionsBeforeChange |= status.st_mode & 07777;
    return FailingCall::failsNow("fchmod") ? -1 : real(file, mode);
}
