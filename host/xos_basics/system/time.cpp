#include "host/xos_basics/control/control.h"

#include "basis/platform/xos_basics.h"

#include <chrono>
#include <thread>

extern "C" {

void xos_TaskSleep(uint32_t ms) {
    auto const sleep = [=] {
        std::this_thread::sleep_for(std::chrono::milliseconds{ms});
        return host::NEVER_FAILS;
    };
    host::call(host::Function::xos_TaskSleep, host::NEVER_FAILS, sleep, ms);
}

uint32_t xos_MsCount(void) {
    auto const count = [] {
        auto const now = std::chrono::steady_clock::now().time_since_epoch();
        return static_cast<uint32_t>(std::chrono::duration_cast<std::chrono::milliseconds>(now).count());
    };
    return host::call<uint32_t>(host::Function::xos_MsCount, host::NEVER_FAILS, count);
}

} // extern "C"
