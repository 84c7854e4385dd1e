// The sibling is reason_win.cpp.

#include "tools/zbtool/complaint.h"

#include <cerrno>
#include <system_error>

namespace zbtool {

std::string lastReason() { return std::generic_category().message(errno); }

bool lastFailureNeedsCopy() { return errno == EXDEV; }

} // namespace zbtool
