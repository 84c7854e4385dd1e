/// \file
/// A record of calls that begins empty, and what it says.

#ifndef TESTS_HOST_XOS_BASICS_CONTROL_RECORDED_CALLS_H
#define TESTS_HOST_XOS_BASICS_CONTROL_RECORDED_CALLS_H

#include "host/include/xos_host.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <cstdio>
#include <string>

class RecordedCalls : public testing::Test {
protected:
    RecordedCalls() {
        xos_HostFailClear();
        xos_HostCallsReset();
    }
    ~RecordedCalls() override { xos_HostFailClear(); }
};

/// The entry of a task.
inline void doNothing(void*) {}

inline std::string lastCall(char const* function) {
    char const* const text = xos_HostLastCall(function);
    return text == nullptr ? "no call" : text;
}

inline std::string hexadecimal(std::uint64_t number) {
    char text[32];
    std::snprintf(text, sizeof text, "0x%llx", static_cast<unsigned long long>(number));
    return text;
}

#endif
