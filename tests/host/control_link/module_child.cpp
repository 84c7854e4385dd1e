// Says by its exit code whose modules it runs on: the sum of what each of the three answers.

#include "basis/platform/hq_basis.h"
#include "basis/platform/xos_basics.h"
#include "basis/platform/xos_url.h"
#include "tests/host/control_link/answers.h"

int main() {
    auto* const never = +[](HQ_Basis::AlertTimer::Alert const&) -> std::uint32_t { return 60'000; };
    int sum = 0;
    if (xos_StrCmp("the", "same") == OTHER_BASICS) sum += OTHER_BASICS;
    if (xos_URLGet("nothing", "nowhere", nullptr, nullptr) == OTHER_URL) sum += OTHER_URL;
    std::uint32_t const alert = HQ_Basis::AlertTimer::New(60'000, never, nullptr);
    if (alert == 0) return ALERT_FAILED;
    if (alert == OTHER_ALERTS) sum += OTHER_ALERTS;
    HQ_Basis::AlertTimer::Delete(alert);
    return sum;
}
