/// \file
/// Waits for what other threads are about to do.

#ifndef TESTS_SUPPORT_WAIT_FOR_H
#define TESTS_SUPPORT_WAIT_FOR_H

#include <chrono>
#include <thread>

/// Tries a condition again and again, for 30 s at most.
/// \return whether it became true
template <class Condition>
bool waitFor(Condition const& condition) {
    auto const end = std::chrono::steady_clock::now() + std::chrono::seconds(30);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::sleep_for(std::chrono::microseconds(100));
    }
    return true;
}

#endif
