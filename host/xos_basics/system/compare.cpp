#include "host/xos_basics/control/control.h"

#include "basis/platform/xos_basics.h"

#include <cstring>

extern "C" int xos_StrCmp(char const* a, char const* b) {
    auto const compare = [=] {
        if (a == nullptr || b == nullptr) return static_cast<int>(a != nullptr) - static_cast<int>(b != nullptr);
        return std::strcmp(a, b);
    };
    return host::call(host::Function::xos_StrCmp, host::NEVER_FAILS, compare, a, b);
}
