#include "host/control_link/control_link.h"

#include "host/include/xos_host.h"

namespace host {

bool failsNow(char const* function, std::initializer_list<std::uint64_t> arguments) {
    auto* const enter = reinterpret_cast<decltype(&xos_HostEnter)>(findControl("xos_HostEnter"));
    return enter != nullptr && enter(function, arguments.begin(), static_cast<std::uint32_t>(arguments.size())) != 0;
}

void offerAlertFire(int (*fire)(std::uint32_t id)) {
    auto* const offer = reinterpret_cast<decltype(&xos_HostOfferAlertFire)>(findControl("xos_HostOfferAlertFire"));
    if (offer != nullptr) offer(fire);
}

} // namespace host
