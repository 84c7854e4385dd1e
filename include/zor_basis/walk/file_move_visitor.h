/// \file
/// `FileMoveVisitor`: moves the entries that a walk reports into one directory.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_FILE_MOVE_VISITOR_H
#define ZOR_BASIS_WALK_FILE_MOVE_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/walk/file_visitor.h"

namespace ZOR_Basis {

/// Nothing is taken back where a move fails midway; `File::Move` and `Dir::Move` say what becomes of the source.
/// \thread  the walking thread
class ZB_API FileMoveVisitor : public FileVisitor {
public:
    /// \param target  the directory; it is not made
    /// \param overwrite  what is at the destination is removed first, a directory with all that is in it
    FileMoveVisitor(Str const& target, bool overwrite) : target_(target), overwrite_(overwrite) {}

    /// Moves one entry under its own name. An entry whose directory is the target, by its text, is left alone: true.
    /// \return false where something is at the destination without `overwrite`, or cannot be removed, or the move fails
    bool perform(FileEntry* entry) override;

private:
    FPath target_;
    bool overwrite_;
};

} // namespace ZOR_Basis

#endif
