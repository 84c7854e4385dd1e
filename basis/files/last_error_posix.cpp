// The sibling is last_error_win.cpp.

#include "basis/files/last_error.h"

#include <cerrno>

namespace ZOR_Basis {
namespace {

int codeOf(Reason reason) {
    switch (reason) {
    case Reason::ALREADY_THERE:
        return EEXIST;
    case Reason::IS_DIRECTORY:
        return EISDIR;
    case Reason::NOT_DIRECTORY:
        return ENOTDIR;
    case Reason::NOT_FOUND:
        return ENOENT;
    case Reason::BAD_ARGUMENT:
        return EINVAL;
    case Reason::NOT_OPEN:
        return EBADF;
    case Reason::NO_MEMORY:
        return ENOMEM;
    case Reason::NO_PROCESS:
        return ESRCH;
    case Reason::NOT_SUPPORTED:
        return ENOTSUP;
    case Reason::LOGON_REFUSED:
        return EKEYREJECTED;
    }
    return EIO;
}

} // namespace

bool refuse(Reason reason) {
    errno = codeOf(reason);
    return false;
}

LastError::LastError() : code_(static_cast<std::uint32_t>(errno)) {}
void LastError::restore() const { errno = static_cast<int>(code_); }

RuntimeCall::RuntimeCall() = default;
void RuntimeCall::fail() const {}

} // namespace ZOR_Basis
