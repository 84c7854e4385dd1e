/// \file
/// The command `copy`.

#ifndef TOOLS_ZBTOOL_COPY_H
#define TOOLS_ZBTOOL_COPY_H

#include "tools/zbtool/progress.h"

#include <zor_basis/files.h>

#include <span>
#include <string>
#include <vector>

namespace zbtool {

struct CopyOptions {
    std::vector<std::string> paths; ///< the sources and behind them the target
    bool overwrite = false;
};

int copy(CopyOptions const& options);

/// Copies one entry, a folder with all its contents, to a path. An existing folder there is filled up.
/// \param overwrite  replaces existing files, each as a whole
/// \return false, with a complaint, at the first entry that cannot be copied; what was copied before stays
bool copyEntry(ZOR_Basis::FPath const& source, ZOR_Basis::FPath const& target, bool overwrite, Progress& progress);

/// Where each source goes: into the target if that is a folder, otherwise to the target's own path.
/// \return an empty path, with a complaint, if several sources have no folder to go into, or if a source is missing or
///     contains its destination
ZOR_Basis::FPath destinationOf(std::string const& source, std::string const& target, bool isOnly);

/// Whether no two sources have one name, as the second would replace the first in the folder that they go into.
/// \return false, with a complaint that names both
bool haveDistinctNames(std::span<std::string const> sources);

} // namespace zbtool

#endif
