/// \file
/// The installation's root folder as text, for rooms below `Sys`, which returns it as a path.

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

/// The root. It is kept for the life of the process once it is not empty; until then each call looks for it.
/// \thread thread-safe; one thread asks at a time, and others that call meanwhile share its answer unless it is empty
Root const& get();

/// The root that the platform layer's answer or the current folder stands for.
Root fromFolder(char const* folder);

} // namespace ZOR_Basis::RootFolder

#endif
