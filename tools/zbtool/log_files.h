/// \file
/// The command `log`.

#ifndef TOOLS_ZBTOOL_LOG_FILES_H
#define TOOLS_ZBTOOL_LOG_FILES_H

#include <string>

namespace zbtool {

struct LogOptions {
    std::string name;
    std::string root;
    int session = -1; ///< all
    bool follow = false;
};

/// Prints the lines of a log, and with `follow` those that come.
int printLog(LogOptions const& options);

} // namespace zbtool

#endif
