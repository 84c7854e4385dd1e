/// \file
/// The platform layer's milliseconds, set by hand: this program defines its own `xos_MsCount`.

#ifndef TESTS_LOG_HAND_CLOCK_H
#define TESTS_LOG_HAND_CLOCK_H

#include <atomic>
#include <cstdint>

extern std::atomic<std::uint32_t> handClock;

#endif
