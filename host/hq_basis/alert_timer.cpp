#include "host/control_link/control_link.h"
#include "host/hq_basis/alert_service.h"

#include <new>

namespace {

int fireAlert(std::uint32_t id) { return host::AlertService::instance().fire(id) ? 0 : -1; }

} // namespace

namespace HQ_Basis {

std::uint32_t AlertTimer::New(std::uint32_t periodMs, Callback callback, void* context) {
    auto const callbackWord = static_cast<std::uint64_t>(reinterpret_cast<std::uintptr_t>(callback));
    auto const add = [=]() -> std::uint32_t {
        if (callback == nullptr) return 0;
        try {
            host::offerAlertFire(fireAlert);
            return host::AlertService::instance().add(periodMs, callback, context);
        } catch (std::bad_alloc const&) { return 0; }
    };
    return host::call<std::uint32_t>("HQ_Basis::AlertTimer::New",
                                     {periodMs, callbackWord, host::addressArgument(context)}, 0, add);
}

void AlertTimer::Delete(std::uint32_t id) {
    auto const remove = [=] {
        host::AlertService::instance().remove(id);
        return 0;
    };
    host::call("HQ_Basis::AlertTimer::Delete", {id}, -1, remove);
}

} // namespace HQ_Basis
