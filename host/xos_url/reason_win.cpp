// The sibling is reason_posix.cpp.

#include "host/xos_url/reason.h"

#include "host/windows_api.h"

#include <winhttp.h>

namespace host {

namespace {

DWORD codeOf(Reason reason) {
    switch (reason) {
    case Reason::BAD_ARGUMENT:
        return ERROR_INVALID_PARAMETER;
    case Reason::UNKNOWN_SCHEME:
        return ERROR_WINHTTP_UNRECOGNIZED_SCHEME;
    case Reason::NOT_FOUND:
        return ERROR_FILE_NOT_FOUND;
    case Reason::FORBIDDEN:
        return ERROR_ACCESS_DENIED;
    case Reason::DIRECTORY:
        return ERROR_ACCESS_DENIED;
    case Reason::TOO_MANY_STEPS:
        return ERROR_WINHTTP_REDIRECT_FAILED;
    case Reason::BAD_ANSWER:
        return ERROR_WINHTTP_INVALID_SERVER_RESPONSE;
    case Reason::NO_MEMORY:
        return ERROR_NOT_ENOUGH_MEMORY;
    }
    return ERROR_GEN_FAILURE;
}

} // namespace

bool failFor(Reason reason) {
    SetLastError(codeOf(reason));
    return false;
}

KeepReason::KeepReason() : code_(GetLastError()) {}
KeepReason::~KeepReason() { SetLastError(code_); }

} // namespace host
