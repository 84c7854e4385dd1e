#include "host/xos_basics/control/control.h"

#include "basis/platform/xos_basics.h"

#include <cstring>

extern "C" int xos_StrCmp(char const* a, char const* b) {
    static_cast<void>(host::failsNow(host::Function::xos_StrCmp, a, b));
    if (a == nullptr || b == nullptr) return static_cast<int>(a != nullptr) - static_cast<int>(b != nullptr);
    return std::strcmp(a, b);
}
