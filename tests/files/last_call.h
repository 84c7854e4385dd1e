/// \file
/// What a function of the platform layer was last called with.

#ifndef TESTS_FILES_LAST_CALL_H
#define TESTS_FILES_LAST_CALL_H

#include "tests/support/scratch.h"
#include "xos_host.h"

#include <string>

/// The arguments without the scratch folder's path; "none" where there was no call.
inline std::string lastCallIn(Scratch const& scratch, char const* function) {
    char const* const call = xos_HostLastCall(function);
    if (call == nullptr) return "none";
    std::string text = call;
    std::string const own = scratch.path() + "/";
    for (std::size_t i = text.find(own); i != std::string::npos; i = text.find(own)) text.erase(i, own.size());
    return text;
}

#endif
