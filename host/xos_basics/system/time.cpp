#include "host/xos_basics/control/control.h"

#include "basis/platform/xos_basics.h"

#include <chrono>
#include <thread>

extern "C" {

void xos_TaskSleep(uint32_t ms) {
    static_cast<void>(host::failsNow(host::Function::xos_TaskSleep, ms));
    std::this_thread::sleep_for(std::chrono::milliseconds{ms});
}

uint32_t xos_MsCount(void) {
    static_cast<void>(host::failsNow(host::Function::xos_MsCount));
    auto const now = std::chrono::steady_clock::now().time_since_epoch();
    return static_cast<uint32_t>(std::chrono::duration_cast<std::chrono::milliseconds>(now).count());
}

} // extern "C"
