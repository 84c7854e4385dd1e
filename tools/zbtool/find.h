/// \file
/// The command `find`.

#ifndef TOOLS_ZBTOOL_FIND_H
#define TOOLS_ZBTOOL_FIND_H

#include <string>

namespace zbtool {

struct FindOptions {
    std::string folder;
    std::string wildcard;
    std::string name;
    std::string extension;
    bool anyCase = false;
    bool files = false;
    bool folders = false;
    bool first = false;
    bool flat = false;
};

/// Prints the paths that match all that is asked for.
/// \return `FAILED` also if there is none
int find(FindOptions const& options);

} // namespace zbtool

#endif
