#include "tools/zbtool/complaint.h"

#include "tools/zbtool/byte_text.h"
#include "tools/zbtool/interruption.h"
#include "tools/zbtool/progress.h"

#include <cstdio>

namespace zbtool {

bool complain(std::string_view subject, std::string_view reason) {
    if (isInterrupted()) return false;
    std::string line = "zbtool: ";
    line.append(harmlessText(subject)).append(": ").append(harmlessText(reason)).append("\n");
    Progress::hide();
    std::fwrite(line.data(), 1, line.size(), stderr);
    return false;
}

bool complain(std::string_view subject) { return complain(subject, lastReason()); }

} // namespace zbtool
