// The sibling is named_mutex_win.cpp.

#include "host/xos_basics/last_error.h"
#include "host/xos_basics/semaphores/named_mutex.h"
#include "host/xos_basics/semaphores/run_file_posix.h"

#include <cerrno>
#include <memory>
#include <new>
#include <pthread.h>
#include <string>
#include <sys/file.h>
#include <unistd.h>

namespace host {

/// Threads of this process queue at a robust mutex; the one that has it locks the file against other processes. The
/// system gives a file lock back when its process ends, however it ends, and says so of a thread through the mutex.
class NamedMutex {
public:
    explicit NamedMutex(int file) : file_(file) {
        pthread_mutexattr_t attributes;
        pthread_mutexattr_init(&attributes);
        pthread_mutexattr_settype(&attributes, PTHREAD_MUTEX_RECURSIVE);
        pthread_mutexattr_setrobust(&attributes, PTHREAD_MUTEX_ROBUST);
        pthread_mutex_init(&threads_, &attributes);
        pthread_mutexattr_destroy(&attributes);
    }
    NamedMutex(NamedMutex const&) = delete;
    NamedMutex& operator=(NamedMutex const&) = delete;

    int take() {
        int error = pthread_mutex_lock(&threads_);
        if (error == EOWNERDEAD) {
            pthread_mutex_consistent(&threads_);
            depth_ = 0;
        } else if (error != 0) {
            return error;
        }
        error = depth_ == 0 ? lockFile() : 0;
        if (error != 0) {
            pthread_mutex_unlock(&threads_);
            return error;
        }
        ++depth_;
        return 0;
    }

    int give() {
        if (!isMine()) return EPERM;
        if (--depth_ == 0) flock(file_, LOCK_UN);
        return pthread_mutex_unlock(&threads_);
    }

private:
    int lockFile() const {
        while (flock(file_, LOCK_EX) != 0) {
            if (errno != EINTR) return errno;
        }
        return 0;
    }

    /// Tries the mutex once more: only its owner gets a second turn while `depth_` is above 0.
    bool isMine() {
        int const error = pthread_mutex_trylock(&threads_);
        if (error == EOWNERDEAD) {
            pthread_mutex_consistent(&threads_);
            depth_ = 0;
            flock(file_, LOCK_UN);
        } else if (error != 0) {
            return false;
        }
        bool const held = depth_ != 0;
        pthread_mutex_unlock(&threads_);
        return held;
    }

    pthread_mutex_t threads_{};
    int file_;
    /// How often the owner has taken it; the owner's alone.
    int depth_{0};
};

namespace {

/// The parents of the users' run directories. All processes of a user must come to the same one, with or without a
/// login session, so these are fixed places.
constexpr char const* const PARENTS[] = {"/run/lock", "/dev/shm", "/tmp"};

} // namespace

NamedMutex* openNamed(int id) {
    int const file = openRunFile(PARENTS, "mutex-" + std::to_string(id));
    if (file < 0) return nullptr;
    auto* const mutex = new (std::nothrow) NamedMutex(file);
    if (mutex == nullptr) {
        close(file);
        setLastError(Error::NO_MEMORY);
    }
    return mutex;
}

int takeNamed(NamedMutex& mutex) {
    int const error = mutex.take();
    if (error != 0) errno = error;
    return error;
}

int giveNamed(NamedMutex& mutex) {
    int const error = mutex.give();
    if (error != 0) errno = error;
    return error;
}

} // namespace host
