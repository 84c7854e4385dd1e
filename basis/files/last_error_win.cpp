// The sibling is last_error_posix.cpp.

#include "basis/files/last_error.h"

#include "basis/platform/windows_api_win.h"

#include <cerrno>

namespace ZOR_Basis {
namespace {

DWORD codeOf(Reason reason) {
    switch (reason) {
    case Reason::ALREADY_THERE:
        return ERROR_ALREADY_EXISTS;
    case Reason::IS_DIRECTORY:
        return ERROR_ACCESS_DENIED;
    case Reason::NOT_DIRECTORY:
        return ERROR_DIRECTORY;
    case Reason::NOT_FOUND:
        return ERROR_FILE_NOT_FOUND;
    case Reason::NO_PROCESS:
    case Reason::BAD_ARGUMENT:
        return ERROR_INVALID_PARAMETER;
    case Reason::NOT_OPEN:
        return ERROR_INVALID_HANDLE;
    case Reason::NO_MEMORY:
        return ERROR_NOT_ENOUGH_MEMORY;
    case Reason::NOT_SUPPORTED:
        return ERROR_NOT_SUPPORTED;
    case Reason::LOGON_REFUSED:
        return ERROR_LOGON_FAILURE;
    }
    return ERROR_GEN_FAILURE;
}

DWORD codeOfRuntime(int error) {
    switch (error) {
    case ENOENT:
        return ERROR_FILE_NOT_FOUND;
    case EACCES:
        return ERROR_ACCESS_DENIED;
    case EEXIST:
        return ERROR_ALREADY_EXISTS;
    case EBADF:
        return ERROR_INVALID_HANDLE;
    case EINVAL:
        return ERROR_INVALID_PARAMETER;
    case ENOMEM:
        return ERROR_NOT_ENOUGH_MEMORY;
    case ENOSPC:
        return ERROR_DISK_FULL;
    case EMFILE:
        return ERROR_TOO_MANY_OPEN_FILES;
    default:
        return ERROR_GEN_FAILURE;
    }
}

} // namespace

bool refuse(Reason reason) {
    SetLastError(codeOf(reason));
    return false;
}

LastError::LastError() : code_(GetLastError()) {}
void LastError::restore() const { SetLastError(code_); }

RuntimeCall::RuntimeCall() { SetLastError(ERROR_SUCCESS); }
void RuntimeCall::fail() const {
    if (GetLastError() == ERROR_SUCCESS) SetLastError(codeOfRuntime(errno));
}

} // namespace ZOR_Basis
