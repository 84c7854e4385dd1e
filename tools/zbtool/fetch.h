/// \file
/// The command `url`.

#ifndef TOOLS_ZBTOOL_FETCH_H
#define TOOLS_ZBTOOL_FETCH_H

#include <string>

namespace zbtool {

struct FetchOptions {
    std::string url;
    std::string target;
    std::string user;
    std::string passwordFile;
    bool overwrite = false;
};

/// Fetches what a URL names into a file.
int fetch(FetchOptions const& options);

} // namespace zbtool

#endif
