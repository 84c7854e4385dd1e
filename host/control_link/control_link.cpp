#include "host/control_link/control_link.h"

#include "host/include/xos_host.h"

namespace host {

bool failsNow(char const* function, Arguments arguments) {
    auto* const enter = reinterpret_cast<decltype(&xos_HostEnter)>(findControl("xos_HostEnter"));
    return enter != nullptr && enter(function, arguments.begin(), static_cast<std::uint32_t>(arguments.size())) != 0;
}

void* beginTrace(char const* function, Arguments arguments) {
    auto* const begin = reinterpret_cast<decltype(&xos_HostTraceBegin)>(findControl("xos_HostTraceBegin"));
    if (begin == nullptr) return nullptr;
    return begin(function, arguments.begin(), static_cast<std::uint32_t>(arguments.size()));
}

void endTrace(void* traced, std::uint64_t result, bool hasFailed) {
    if (traced == nullptr) return;
    auto* const end = reinterpret_cast<decltype(&xos_HostTraceEnd)>(findControl("xos_HostTraceEnd"));
    if (end != nullptr) end(traced, result, hasFailed ? 1 : 0);
}

void offerAlertFire(int (*fire)(std::uint32_t id)) {
    auto* const offer = reinterpret_cast<decltype(&xos_HostOfferAlertFire)>(findControl("xos_HostOfferAlertFire"));
    if (offer != nullptr) offer(fire);
}

} // namespace host
