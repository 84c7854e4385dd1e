// The sibling is kept_error_posix.cpp.

#include "basis/files/kept_error.h"

#include "basis/platform/windows_api.h"

namespace ZOR_Basis {

KeptError::KeptError() : code_(GetLastError()) {}

KeptError::~KeptError() { SetLastError(code_); }

} // namespace ZOR_Basis
