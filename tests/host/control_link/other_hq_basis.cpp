// A module of the same name.

#include "basis/platform/hq_basis.h"
#include "tests/host/control_link/answers.h"

namespace HQ_Basis {

std::uint32_t AlertTimer::New(std::uint32_t, Callback, void*) { return OTHER_ALERTS; }

void AlertTimer::Delete(std::uint32_t) {}

} // namespace HQ_Basis
