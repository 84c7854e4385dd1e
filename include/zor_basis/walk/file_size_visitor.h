/// \file
/// `FileSizeVisitor`: sums the sizes of the entries that a walk reports.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_FILE_SIZE_VISITOR_H
#define ZOR_BASIS_WALK_FILE_SIZE_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/text/str.h"
#include "zor_basis/walk/file_visitor.h"

#include <cstdint>

namespace ZOR_Basis {

/// A link counts 0 on Linux: what it leads to lies elsewhere, or around the entry itself.
/// \thread  the walking thread
class ZB_API FileSizeVisitor : public FileVisitor {
public:
    /// \param recursive  of directories the whole trees, else only the files that lie in them directly
    FileSizeVisitor(bool recursive) : recursive_(recursive) {}

    /// Adds the size of an entry, as `Get` has it. In a deep walk that reports directories, what lies in them is therefore
    /// counted once for each report. \return true
    bool perform(FileEntry* entry) override;
    /// Bytes.
    std::int64_t total() const { return total_; }

    /// The size of a file, or of all files in a directory; 0 where nothing is.
    /// \param recursive  with those in its sub-directories, at any depth
    static std::int64_t Get(Str const& path, bool recursive);

private:
    std::int64_t total_ = 0;
    bool recursive_;
};

} // namespace ZOR_Basis

#endif
