/// \file
/// `FileVisitor`: what a walk does with the entries that it finds.
///
/// \thread  called by the walking thread, inside the walk

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
    /// \param entry  never null; valid during the call
    /// \return false is a failure; it ends a walk with `stopOnFalse`
    virtual bool perform(FileEntry* entry) = 0;
    /// Asked before every name of a listing, also before the end of it is found, and once more in each directory when its
    /// own entries are done. True ends the walk at all its levels, each of which asks again, and leaves its result as it is.
    /// \return false in this class
    virtual bool stop();
    virtual ~FileVisitor();
};

} // namespace ZOR_Basis

#endif
