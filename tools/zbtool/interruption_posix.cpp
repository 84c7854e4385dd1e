// The sibling is interruption_win.cpp.

#include "tools/zbtool/interruption.h"

#include <atomic>
#include <csignal>
#include <cstdlib>
#include <ctime>
#include <thread>
#include <unistd.h>

namespace zbtool {
namespace {

constexpr time_t PATIENCE_SECONDS = 1;

std::atomic<int> received{0};

sigset_t watchedSignals() {
    sigset_t set;
    ::sigemptyset(&set);
    for (int signal : {SIGINT, SIGTERM, SIGHUP}) ::sigaddset(&set, signal);
    return set;
}

void waitForSignal(void (*clear)()) {
    sigset_t const set = watchedSignals();
    int signal = 0;
    if (::sigwait(&set, &signal) != 0) return;
    received = signal;
    timespec const patience{PATIENCE_SECONDS, 0};
    ::sigtimedwait(&set, nullptr, &patience);
    clear();
    endAsInterrupted();
}

} // namespace

void watchForInterruption(void (*clear)()) {
    sigset_t const set = watchedSignals();
    ::pthread_sigmask(SIG_BLOCK, &set, nullptr);
    std::thread(waitForSignal, clear).detach();
}

bool isInterrupted() { return received.load(std::memory_order_relaxed) != 0; }

void endAsInterrupted() {
    int const signal = received;
    std::signal(signal, SIG_DFL);
    sigset_t const set = watchedSignals();
    ::pthread_sigmask(SIG_UNBLOCK, &set, nullptr);
    ::raise(signal);
    ::_exit(EXIT_FAILURE);
}

} // namespace zbtool
