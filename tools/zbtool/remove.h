/// \file
/// The command `delete`.

#ifndef TOOLS_ZBTOOL_REMOVE_H
#define TOOLS_ZBTOOL_REMOVE_H

#include "tools/zbtool/progress.h"

#include <zor_basis/files.h>

#include <string>
#include <vector>

namespace zbtool {

struct RemoveOptions {
    std::vector<std::string> paths;
    bool yes = false;
};

int remove(RemoveOptions const& options);

/// Removes an entry, a folder with all its contents; of a link only itself.
/// \param progress  is told of each entry; null: the library removes a folder in one step, which is faster
/// \return false, with a complaint about each entry that cannot be removed; all others are gone
bool removeEntry(ZOR_Basis::FPath const& path, Progress* progress);

} // namespace zbtool

#endif
