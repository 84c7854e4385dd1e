#include "host/include/xos_host.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/last_error.h"
#include "host/xos_basics/result.h"

#include "basis/platform/xos_basics.h"

#include <atomic>
#include <cstring>

namespace {

constexpr std::uint32_t FUNCTION_RESOLVER = 0xFFFF8006;

constinit std::atomic<xos_HostResolver> resolver{nullptr};

int lookUp(uint32_t id, void* out, uint64_t size) {
    xos_HostResolver const answer = resolver.load();
    if (id != FUNCTION_RESOLVER || answer == nullptr || out == nullptr || size < sizeof answer) {
        host::setLastError(host::Error::NOT_FOUND);
        return 0;
    }
    std::memcpy(out, &answer, sizeof answer);
    return static_cast<int>(sizeof answer);
}

} // namespace

extern "C" {

void xos_HostSetResolver(xos_HostResolver function) { resolver.store(function); }

int xos_BasicsParamLookup(uint32_t id, void* out, uint64_t size) {
    auto const look = [=] { return lookUp(id, out, size); };
    return host::call(host::Function::xos_BasicsParamLookup, host::FAILED, look, id, out, size);
}

} // extern "C"
