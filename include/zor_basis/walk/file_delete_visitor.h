/// \file
/// `FileDeleteVisitor`: removes the entries that a walk reports. `zbCheckRemoveFileDir`: removes one entry.
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_FILE_DELETE_VISITOR_H
#define ZOR_BASIS_WALK_FILE_DELETE_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/walk/file_visitor.h"

namespace ZOR_Basis {

/// \thread the walking thread
class ZB_API FileDeleteVisitor : public FileVisitor {
public:
    /// Removes one entry, a directory with all its contents.
    /// \return whether the entry is gone
    bool perform(FileEntry* entry) override;
};

} // namespace ZOR_Basis

/// Checks that nothing exists at a path, or removes what exists.
/// \param remove  removes an existing entry: a directory with all its contents, a link itself and not its target
/// \return whether the path is free: true if nothing existed; false if something exists and `remove` is false
/// \thread thread-safe as far as the file system is
ZB_API bool zbCheckRemoveFileDir(ZOR_Basis::FPath const& path, bool remove);

#endif
