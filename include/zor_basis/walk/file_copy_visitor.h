/// \file
/// `FileCopyVisitor`: copies the entries that a walk reports into one directory.
///
///     FileCopyVisitor copier("backup", true, true);
///     FileIterator("jobs", LOOK_BOTH, nullptr, nullptr).doIt(&copier, false, true);
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_FILE_COPY_VISITOR_H
#define ZOR_BASIS_WALK_FILE_COPY_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/walk/file_visitor.h"

namespace ZOR_Basis {

/// If a copy fails midway, what was copied stays.
/// \thread the walking thread
class ZB_API FileCopyVisitor : public FileVisitor {
public:
    /// \param target  names the directory; the visitor does not make it
    /// \param overwrite  removes an existing destination first, a directory with all its contents
    /// \param recursive  copies directories with their sub-directories; false: with their files only
    FileCopyVisitor(Str const& target, bool overwrite, bool recursive)
        : target_(target), overwrite_(overwrite), recursive_(recursive) {}

    /// Copies one entry under its own name. Leaves an entry whose directory has the same text as the target alone and
    /// returns true.
    /// \return false if the destination exists and `overwrite` is false, or if it cannot be removed, or if the copy
    ///     fails
    bool perform(FileEntry* entry) override;

private:
    FPath target_;
    bool overwrite_;
    bool recursive_;
};

} // namespace ZOR_Basis

#endif
