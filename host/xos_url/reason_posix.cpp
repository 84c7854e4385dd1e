// The sibling is reason_win.cpp.

#include "host/xos_url/reason.h"

#include <cerrno>

namespace host {

namespace {

int codeOf(Reason reason) {
    switch (reason) {
    case Reason::badArgument:
        return EINVAL;
    case Reason::unknownScheme:
        return EPROTONOSUPPORT;
    case Reason::notFound:
        return ENOENT;
    case Reason::forbidden:
        return EACCES;
    case Reason::directory:
        return EISDIR;
    case Reason::tooManySteps:
        return ELOOP;
    case Reason::badAnswer:
        return EPROTO;
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
