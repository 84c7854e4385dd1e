/// \file
/// `FileMoveVisitor`: moves the entries that a walk reports into one directory.
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_FILE_MOVE_VISITOR_H
#define ZOR_BASIS_WALK_FILE_MOVE_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/walk/file_visitor.h"

namespace ZOR_Basis {

/// If a move fails midway, nothing is undone; `File::Move` and `Dir::Move` say what happens to the source.
/// \thread the walking thread
class ZB_API FileMoveVisitor : public FileVisitor {
public:
    /// \param target  names the directory; the visitor does not make it
    /// \param overwrite  removes an existing destination first, a directory with all its contents
    FileMoveVisitor(Str const& target, bool overwrite) : target_(target), overwrite_(overwrite) {}

    /// Moves one entry under its own name. Leaves an entry whose directory has the same text as the target alone and
    /// returns true.
    /// \return false if the destination exists and `overwrite` is false, or if it cannot be removed, or if the move
    ///     fails
    bool perform(FileEntry* entry) override;

private:
    FPath target_;
    bool overwrite_;
};

} // namespace ZOR_Basis

#endif
