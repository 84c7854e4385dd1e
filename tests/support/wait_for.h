/// \file
/// Waits for what another thread does.

#ifndef TESTS_SUPPORT_WAIT_FOR_H
#define TESTS_SUPPORT_WAIT_FOR_H

#include <chrono>
#include <functional>
#include <thread>

/// \return whether the condition came true within half a minute
inline bool waitFor(std::function<bool()> const& condition) {
    auto const end = std::chrono::steady_clock::now() + std::chrono::seconds(30);
    while (!condition()) {
        if (std::chrono::steady_clock::now() > end) return false;
        std::this_thread::sleep_for(std::chrono::microseconds(100));
    }
    return true;
}

#endif
