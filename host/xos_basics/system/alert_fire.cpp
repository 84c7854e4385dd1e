#include "host/include/xos_host.h"

#include <atomic>

namespace {

/// Where module hq_basis runs an alert; null while it has not said.
constinit std::atomic<int (*)(uint32_t)> fire{nullptr};

} // namespace

extern "C" {

void xos_HostOfferAlertFire(int (*function)(uint32_t id)) { fire.store(function); }

int xos_HostAlertFire(uint32_t id) {
    int (*const function)(uint32_t) = fire.load();
    return function == nullptr ? -1 : function(id);
}

} // extern "C"
