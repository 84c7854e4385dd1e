// The sibling is process_end_win.cpp. What the logs hold is written when the process ends.

#include "basis/log/logger_impl.h"
#include "basis/log/loggers.h"

#include <pthread.h>

namespace ZOR_Basis {
namespace {

void beforeFork() { loggers().mutex.lock(); }
void inParent() { loggers().mutex.unlock(); }
/// A forked copy inherits lines that the original process writes.
void inCopy() {
    for (LoggerImpl* logger = loggers().list.first(); logger != nullptr; logger = logger->next) logger->becomeCopy();
    loggers().mutex.unlock();
}

[[gnu::constructor]] void watchForks() { pthread_atfork(beforeFork, inParent, inCopy); }

/// Runs after the destructors of all static objects, those of programs that load the library late included.
[[gnu::destructor]] void writeOutAllLogs() {
    std::lock_guard const held(loggers().mutex);
    for (LoggerImpl* logger = loggers().list.first(); logger != nullptr; logger = logger->next) {
        if (!logger->isCopy()) logger->flush();
    }
}

} // namespace
} // namespace ZOR_Basis
