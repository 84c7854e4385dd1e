#include "tools/zbtool/complaint.h"

#include "tools/zbtool/interruption.h"
#include "tools/zbtool/progress.h"

#include <cstdio>

namespace zbtool {

bool complain(std::string_view subject, std::string_view reason) {
    if (isInterrupted()) return false;
    std::string line = "zbtool: ";
    line.append(subject).append(": ").append(reason).append("\n");
    Progress::hide();
    std::fwrite(line.data(), 1, line.size(), stderr);
    return false;
}

bool complain(std::string_view subject) { return complain(subject, lastReason()); }

} // namespace zbtool
