/// \file
/// `FileSizeVisitor`: adds up the sizes of the entries that a walk reports.
///
///     std::int64_t const bytes = FileSizeVisitor::Get(folder, true); // of a whole tree
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_FILE_SIZE_VISITOR_H
#define ZOR_BASIS_WALK_FILE_SIZE_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/text/str.h"
#include "zor_basis/walk/file_visitor.h"

#include <cstdint>

namespace ZOR_Basis {

/// On Linux a link counts 0: its target lies elsewhere, or contains the entry itself.
/// \thread the walking thread
class ZB_API FileSizeVisitor : public FileVisitor {
public:
    /// \param recursive  counts the whole tree of a directory; false: only the files directly in it
    FileSizeVisitor(bool recursive) : recursive_(recursive) {}

    /// Adds the size of an entry, as `Get` computes it. A deep walk that reports directories therefore counts their
    /// contents once for each report.
    /// \return true
    bool perform(FileEntry* entry) override;
    /// The sum in bytes.
    std::int64_t total() const { return total_; }

    /// Returns the size of a file, or of all files in a directory; 0 if nothing exists.
    /// \param recursive  includes the files in sub-directories, at any depth
    static std::int64_t Get(Str const& path, bool recursive);

private:
    std::int64_t total_ = 0;
    bool recursive_;
};

} // namespace ZOR_Basis

#endif
