// The sibling is reason_win.cpp.

#include "host/xos_url/reason.h"

#include <cerrno>

namespace host {

namespace {

int codeOf(Reason reason) {
    switch (reason) {
    case Reason::BAD_ARGUMENT:
        return EINVAL;
    case Reason::UNKNOWN_SCHEME:
        return EPROTONOSUPPORT;
    case Reason::NOT_FOUND:
        return ENOENT;
    case Reason::FORBIDDEN:
        return EACCES;
    case Reason::DIRECTORY:
        return EISDIR;
    case Reason::TOO_MANY_STEPS:
        return ELOOP;
    case Reason::BAD_ANSWER:
        return EPROTO;
    case Reason::NO_MEMORY:
        return ENOMEM;
    }
    return EIO;
}

} // namespace

bool failFor(Reason reason) {
    errno = codeOf(reason);
    return false;
}

KeepReason::KeepReason() : code_(static_cast<unsigned long>(errno)) {}
KeepReason::~KeepReason() { errno = static_cast<int>(code_); }

} // namespace host
