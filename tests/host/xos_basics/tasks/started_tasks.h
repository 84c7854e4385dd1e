/// \file
/// Starts tasks.

#ifndef TESTS_HOST_XOS_BASICS_TASKS_STARTED_TASKS_H
#define TESTS_HOST_XOS_BASICS_TASKS_STARTED_TASKS_H

#include "basis/platform/xos_basics.h"

#include <atomic>
#include <cstdint>

constexpr xos_Task NO_TASK = ~xos_Task{0};

inline xos_Task start(void (*entry)(void*), void* argument, char const* name = "test", std::uint64_t stackSize = 0) {
    xos_TaskParams const params{entry, argument, 0, -9, stackSize, name, 0};
    return xos_TaskCreate(&params);
}

inline void count(void* counter) { ++*static_cast<std::atomic<int>*>(counter); }

#endif
