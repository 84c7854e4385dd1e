// The sibling is thread_facts_win.cpp.

#include "tests/support/thread_facts.h"

#include <filesystem>
#include <iterator>
#include <pthread.h>

std::string nameOfThisThread() {
    char name[64] = "";
    pthread_getname_np(pthread_self(), name, sizeof name);
    return name;
}

std::size_t const LONGEST_THREAD_NAME = 15;

std::size_t openHandles() {
    std::filesystem::directory_iterator const open{"/proc/self/fd"};
    return static_cast<std::size_t>(std::distance(begin(open), end(open)));
}
