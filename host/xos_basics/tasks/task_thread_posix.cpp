// The sibling is task_thread_win.cpp.

#include "host/xos_basics/tasks/task_thread.h"

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <memory>
#include <new>
#include <pthread.h>

namespace host {

namespace {

struct Start {
    void (*run)(void*);
    void* argument;
};

void* runStart(void* start) {
    std::unique_ptr<Start> const own{static_cast<Start*>(start)};
    own->run(own->argument);
    return nullptr;
}

/// Never below the usual size: an entry may need what the C library's functions need.
int setStackSize(pthread_attr_t& attributes, std::uint64_t size) {
    std::size_t usual = 0;
    pthread_attr_getstacksize(&attributes, &usual);
    return size <= usual ? 0 : pthread_attr_setstacksize(&attributes, size);
}

int startDetached(Start* start, std::uint64_t stackSize) {
    pthread_attr_t attributes;
    pthread_attr_init(&attributes);
    pthread_attr_setdetachstate(&attributes, PTHREAD_CREATE_DETACHED);
    int error = setStackSize(attributes, stackSize);
    if (error == 0) {
        pthread_t thread{};
        error = pthread_create(&thread, &attributes, runStart, start);
    }
    pthread_attr_destroy(&attributes);
    return error;
}

} // namespace

bool startThread(void (*run)(void*), void* argument, std::uint64_t stackSize) {
    std::unique_ptr<Start> start{new (std::nothrow) Start{run, argument}};
    int const error = start == nullptr ? ENOMEM : startDetached(start.get(), stackSize);
    if (error != 0) {
        errno = error;
        return false;
    }
    static_cast<void>(start.release()); // the thread's now
    return true;
}

void nameThisThread(TaskName const& name) {
    constexpr std::size_t LONGEST = 15;
    char shortName[LONGEST + 1] = "";
    std::memcpy(shortName, name.data(), std::min(std::strlen(name.data()), LONGEST));
    pthread_setname_np(pthread_self(), shortName);
}

} // namespace host
