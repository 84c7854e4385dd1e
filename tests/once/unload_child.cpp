// unload_child MODULE HOW: loads a module that uses the library, has it log, unloads it and fires the alerts that may
// be left. HOW the log is left: "closed" or "kept". Nothing else here needs the library.

#include "tests/once/loaded_module.h"
#include "tests/once/unload_module.h"

#include <xos_host.h>

#include <chrono>
#include <cstdint>
#include <cstdio>
#include <future>
#include <string>
#include <thread>

namespace {

/// The alert of a closed log never returns, so it is fired in a thread of its own.
void fireAlerts() {
    std::promise<void> begins;
    std::thread([&begins] {
        begins.set_value();
        constexpr std::uint32_t LAST_TRIED = 16;
        for (std::uint32_t id = 1; id <= LAST_TRIED; ++id) xos_HostAlertFire(id);
    }).detach();
    begins.get_future().wait();
    std::this_thread::sleep_for(std::chrono::milliseconds(300));
}

} // namespace

int main(int argc, char** argv) {
    if (argc != 3) return 2;
    for (int round = 0; round < 2; ++round) {
        void* const module = loadModule(argv[1]);
        if (module == nullptr) return 3;
        auto* const logOneLine = reinterpret_cast<LogOneLine>(addressIn(module, "logOneLine"));
        if (logOneLine == nullptr) return 4;
        logOneLine(std::string(argv[2]) == "kept" ? 1 : 0);
        if (!unloadModule(module)) return 5;
        fireAlerts();
    }
    std::puts("alive");
    return 0;
}
