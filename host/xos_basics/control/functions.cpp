#include "host/xos_basics/control/functions.h"

#include <cstring>

namespace host {

namespace {

constexpr bool kindsFit() {
    for (FunctionFacts const& facts : FUNCTIONS) {
        std::size_t count = 0;
        while (facts.kinds[count] != '\0') { ++count; }
        if (count > MAX_ARGUMENTS) return false;
    }
    return true;
}
static_assert(kindsFit());

} // namespace

Function functionNamed(char const* name) {
    if (name != nullptr) {
        for (std::size_t i = 0; i < FUNCTION_COUNT; ++i) {
            if (std::strcmp(FUNCTIONS[i].name, name) == 0) return static_cast<Function>(i);
        }
    }
    return Function::none;
}

} // namespace host
