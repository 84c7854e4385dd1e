#include "host/control_link/control_link.h"
#include "host/hq_basis/alert_service.h"

#include <new>

namespace {

int fireAlert(std::uint32_t id) { return host::AlertService::instance().fire(id) ? 0 : -1; }

} // namespace

namespace HQ_Basis {

std::uint32_t AlertTimer::New(std::uint32_t periodMs, Callback callback, void* context) {
    auto const callbackWord = static_cast<std::uint64_t>(reinterpret_cast<std::uintptr_t>(callback));
    if (host::failsNow("HQ_Basis::AlertTimer::New", {periodMs, callbackWord, host::addressArgument(context)}) ||
        callback == nullptr) {
        return 0;
    }
    try {
        host::offerAlertFire(fireAlert);
        return host::AlertService::instance().add(periodMs, callback, context);
    } catch (std::bad_alloc const&) { return 0; }
}

void AlertTimer::Delete(std::uint32_t id) {
    if (!host::failsNow("HQ_Basis::AlertTimer::Delete", {id})) host::AlertService::instance().remove(id);
}

} // namespace HQ_Basis
