#include "tests/log/hand_clock.h"

#include "basis/platform/xos_basics.h"

std::atomic<std::uint32_t> handClock{0};

extern "C" uint32_t xos_MsCount(void) { return handClock.load(); }
