/// \file
/// `FileDeleteVisitor`: removes the entries that a walk reports. And `zbCheckRemoveFileDir`, which removes one.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_FILE_DELETE_VISITOR_H
#define ZOR_BASIS_WALK_FILE_DELETE_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/walk/file_visitor.h"

namespace ZOR_Basis {

/// \thread  the walking thread
class ZB_API FileDeleteVisitor : public FileVisitor {
public:
    /// Removes one entry, a directory with all that is in it. \return whether it is gone
    bool perform(FileEntry* entry) override;
};

} // namespace ZOR_Basis

/// Makes sure that a path is free.
/// \param remove  removes what is there, a directory with all that is in it; of a link the link itself
/// \return whether the path is free: true where nothing was there; false without `remove` where something is
/// \thread  thread-safe as far as the file system is
ZB_API bool zbCheckRemoveFileDir(ZOR_Basis::FPath const& path, bool remove);

#endif
