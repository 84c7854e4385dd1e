/// \file
/// The milliseconds of the platform layer, told by hand: this program's own `xos_MsCount` takes the place of the other.

#ifndef TESTS_LOG_HAND_CLOCK_H
#define TESTS_LOG_HAND_CLOCK_H

#include <atomic>
#include <cstdint>

extern std::atomic<std::uint32_t> handClock;

#endif
