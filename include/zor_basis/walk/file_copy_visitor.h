/// \file
/// `FileCopyVisitor`: copies the entries that a walk reports into one directory.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_FILE_COPY_VISITOR_H
#define ZOR_BASIS_WALK_FILE_COPY_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/walk/file_visitor.h"

namespace ZOR_Basis {

/// Nothing is taken back where a copy fails midway.
/// \thread  the walking thread
class ZB_API FileCopyVisitor : public FileVisitor {
public:
    /// \param target  the directory; it is not made
    /// \param overwrite  what is at the destination is removed first, a directory with all that is in it
    /// \param recursive  directories are copied with their sub-directories, else with their files only
    FileCopyVisitor(Str const& target, bool overwrite, bool recursive)
        : target_(target), overwrite_(overwrite), recursive_(recursive) {}

    /// Copies one entry under its own name. An entry whose directory is the target, by its text, is left alone: true.
    /// \return false where something is at the destination without `overwrite`, or cannot be removed or copied
    bool perform(FileEntry* entry) override;

private:
    FPath target_;
    bool overwrite_;
    bool recursive_;
};

} // namespace ZOR_Basis

#endif
