// The control functions of calls and failures.

#include "host/include/xos_host.h"
#include "host/xos_basics/control/calls.h"
#include "host/xos_basics/control/control.h"
#include "host/xos_basics/control/faults.h"

#include <string>

namespace {

/// Notes a call whose arguments come as words, texts by their address.
bool failsNowWithWords(host::Function function, std::uint64_t const* arguments, std::uint32_t count) {
    char const* const kinds = host::factsOf(function).kinds;
    {
        host::CallNote note{function};
        for (std::uint32_t i = 0; i < count && kinds[i] != '\0'; ++i) {
            if (kinds[i] == 't') {
                note.addText(reinterpret_cast<char const*>(arguments[i]));
            } else {
                note.addWord(arguments[i]);
            }
        }
    }
    return host::failsAfterNote(function);
}

} // namespace

extern "C" {

int xos_HostFail(char const* function, uint32_t skip, uint32_t times) {
    return host::injectFailure(function, skip, times) ? 0 : -1;
}

void xos_HostFailClear(void) { host::clearFailures(); }

uint64_t xos_HostCalls(char const* name) {
    host::Function const function = host::functionNamed(name);
    return function == host::Function::none ? 0 : host::callsOf(function);
}

void xos_HostCallsReset(void) { host::resetCalls(); }

char const* xos_HostLastCall(char const* name) {
    host::Function const function = host::functionNamed(name);
    std::string*& text = host::threadCalls().lastCallText;
    if (text == nullptr) text = new std::string;
    return function != host::Function::none && host::lastCallOf(function, *text) ? text->c_str() : nullptr;
}

int xos_HostEnter(char const* name, uint64_t const* arguments, uint32_t count) {
    host::Function const function = host::functionNamed(name);
    return function != host::Function::none && failsNowWithWords(function, arguments, count) ? 1 : 0;
}

} // extern "C"
