/// \file
/// What takes long to copy is copied beside its place first, where an interruption finds it.

#ifndef TOOLS_ZBTOOL_STAGING_H
#define TOOLS_ZBTOOL_STAGING_H

#include <zor_basis/files.h>

#include <functional>
#include <string>

namespace zbtool {

/// Copies a file, or a folder with all its contents, through a folder of its own beside the target, so that
/// `clearStaging` can remove it at any time.
/// \param reason  receives why the copy failed; nothing is left of it then
bool copyStaged(ZOR_Basis::FPath const& target, ZOR_Basis::FPath const& source, bool overwrite, std::string& reason);

/// Makes a file at the path that it is given.
using Fill = std::function<bool(ZOR_Basis::FPath const& staged)>;
/// The same for one file that `fill` makes, as the only work of the program: an interruption ends it here.
bool writeStaged(ZOR_Basis::FPath const& target, Fill const& fill, bool overwrite, std::string& reason);

/// Removes what other threads have half copied. From then on no other file is begun.
void clearStaging();

} // namespace zbtool

#endif
