#include "host/include/xos_host.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/wait/quick_mutex.h"

#include "basis/platform/xos_basics.h"

#include <cstdio>
#include <mutex>

namespace {

struct Listener {
    xos_HostAssertHandler handler;
    void* context;
};

constinit host::QuickMutex mutex;
constinit Listener listener{nullptr, nullptr};

Listener currentListener() {
    std::lock_guard const lock{mutex};
    return listener;
}

char const* orEmpty(char const* text) { return text == nullptr ? "" : text; }

void raise(int line, char const* module, char const* message) {
    // Outside the lock, as a handler may raise assertions of its own or replace itself.
    Listener const heard = currentListener();
    if (heard.handler != nullptr) {
        heard.handler(line, module, message, heard.context);
    } else {
        std::fprintf(stderr, "%s:%d: %s\n", orEmpty(module), line, orEmpty(message));
    }
}

} // namespace

extern "C" {

void xos_HostSetAssertHandler(xos_HostAssertHandler handler, void* context) {
    std::lock_guard const lock{mutex};
    listener = {handler, context};
}

void xos_Assert(int line, char const* module, char const* message) {
    auto const assertion = [=] {
        raise(line, module, message);
        return host::NEVER_FAILS;
    };
    host::call(host::Function::xos_Assert, host::NEVER_FAILS, assertion, line, module, message);
}

} // extern "C"
