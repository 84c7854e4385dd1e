/// \file
/// The command `timers`.

#ifndef TOOLS_ZBTOOL_TIMERS_H
#define TOOLS_ZBTOOL_TIMERS_H

#include <string>
#include <vector>

namespace zbtool {

struct TimersOptions {
    std::vector<std::string> reports;
    bool compare = false;
    std::string sortBy;
    bool reverse = false;
    bool json = false;
    bool csv = false;
    std::string html;
    bool overwrite = false;
};

/// Prints timer reports as one table, or writes it as a page.
int timers(TimersOptions const& options);

} // namespace zbtool

#endif
