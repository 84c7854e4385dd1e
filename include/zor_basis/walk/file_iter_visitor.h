/// \file
/// `FileIterVisitor`: starts a further walk in every directory that a walk reports.

#ifndef ZOR_BASIS_WALK_FILE_ITER_VISITOR_H
#define ZOR_BASIS_WALK_FILE_ITER_VISITOR_H

#include "zor_basis/export.h"
#include "zor_basis/walk/file_iterator.h"
#include "zor_basis/walk/file_visitor.h"

namespace ZOR_Basis {

/// \thread the walking thread
class ZB_API FileIterVisitor : public FileVisitor {
public:
    /// \param it  does the further walks; not owned, not null, and not the iterator that walks with this visitor
    /// \param inner  visits the entries of the further walks; not owned, not null
    FileIterVisitor(FileIterator* it, FileVisitor* inner, bool deep, bool stopOnFalse)
        : it_(it), inner_(inner), deep_(deep), stopOnFalse_(stopOnFalse) {}

    /// Walks the entry if it is a directory.
    /// \kept walk-07: afterwards the iterator still has the path of the directory that it walked last
    /// \return the result of that walk; true if the entry is not a directory
    bool perform(FileEntry* entry) override;

private:
    FileIterator* it_;
    FileVisitor* inner_;
    bool deep_;
    bool stopOnFalse_;
};

} // namespace ZOR_Basis

#endif
