// The sibling is reason_posix.cpp.

#include "tools/zbtool/complaint.h"

#include <windows.h>

namespace zbtool {

std::string lastReason() {
    DWORD const code = GetLastError();
    char text[512];
    DWORD const size = FormatMessageA(FORMAT_MESSAGE_FROM_SYSTEM | FORMAT_MESSAGE_IGNORE_INSERTS, nullptr, code, 0,
                                      text, sizeof text, nullptr);
    std::string reason(text, size);
    // The system's messages are sentences with a line end.
    while (!reason.empty() && std::string(" \r\n.").find(reason.back()) != std::string::npos) reason.pop_back();
    return reason.empty() ? "error " + std::to_string(code) : reason;
}

bool lastFailureNeedsCopy() { return GetLastError() == ERROR_NOT_SAME_DEVICE; }

} // namespace zbtool
