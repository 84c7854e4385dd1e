/// \file
/// Folders directly beneath the root folder.

#ifndef BASIS_SYSTEM_BENEATH_ROOT_H
#define BASIS_SYSTEM_BENEATH_ROOT_H

#include "basis/files/root_folder.h"
#include "zor_basis/files/f_path.h"

namespace ZOR_Basis {

/// Absolute even if the root is the whole file system, whose path is the empty text.
inline FPath beneathRoot(RootFolder::Root const& root, char const* name) {
    FPath path(root.text);
    if (root.isFileSystem) path = "/";
    return path.add(name);
}
inline FPath beneathRoot(char const* name) { return beneathRoot(RootFolder::get(), name); }

} // namespace ZOR_Basis

#endif
