// The sibling is kept_error_win.cpp.

#include "basis/files/kept_error.h"

#include <cerrno>

namespace ZOR_Basis {

KeptError::KeptError() : code_(static_cast<std::uint32_t>(errno)) {}

KeptError::~KeptError() { errno = static_cast<int>(code_); }

} // namespace ZOR_Basis
