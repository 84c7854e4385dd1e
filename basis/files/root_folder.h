/// \file
/// The installation's root folder as text, for those who cannot ask `Sys`, which answers in paths.

#ifndef BASIS_FILES_ROOT_FOLDER_H
#define BASIS_FILES_ROOT_FOLDER_H

#include "zor_basis/text/buf_str.h"

namespace ZOR_Basis::RootFolder {

struct Root {
    /// Forward slashes, none at the end; empty while nothing is known, and where the root is the whole file system.
    BufStr<255> text;
    /// Whether the root is the whole file system, of which an absolute path has no text: only where there is just one.
    bool isFileSystem = false;
};

/// The root, kept for the life of the process once it has a text; until then looked for at each call.
/// \thread thread-safe; one asks at a time, and those that come meanwhile share its answer if it has a text
Root const& get();

/// The root that the platform layer's answer or the current folder stands for.
Root fromFolder(char const* folder);

} // namespace ZOR_Basis::RootFolder

#endif
