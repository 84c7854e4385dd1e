/// \file
/// `FileVisitor`: handles the entries that a walk reports.
///
///     struct Printer : FileVisitor {
///         bool perform(FileEntry* entry) override { return std::puts(entry->getFullPath().c_str()) >= 0; }
///     };
///
/// \thread called by the walking thread, during the walk

#ifndef ZOR_BASIS_WALK_FILE_VISITOR_H
#define ZOR_BASIS_WALK_FILE_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/files/file_entry.h"

namespace ZOR_Basis {

class ZB_API FileVisitor {
public:
    FileVisitor() = default;
    FileVisitor(FileVisitor const&) = default;
    FileVisitor(FileVisitor&&) = default;
    FileVisitor& operator=(FileVisitor const&) = default;
    FileVisitor& operator=(FileVisitor&&) = default;

    /// Handles one entry.
    /// \param entry  is never null and valid during the call
    /// \return false on failure, which ends a walk with `stopOnFalse`
    virtual bool perform(FileEntry* entry) = 0;
    /// Called before every name of a listing, including the call that finds its end, and once more in each directory
    /// after its own entries. True ends the walk at all levels, each of which asks again, and does not change the
    /// walk's result.
    /// \return false in this class
    virtual bool stop();
    virtual ~FileVisitor();
};

} // namespace ZOR_Basis

#endif
