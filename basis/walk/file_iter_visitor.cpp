#include "zor_basis/walk/file_iter_visitor.h"

namespace ZOR_Basis {

bool FileIterVisitor::perform(FileEntry* entry) {
    if (!entry->isDir()) return true;
    // kept walk-07: setting the path back would cost every directory a copy that nobody reads.
    it_->setPath(entry->getFullPath());
    return it_->doIt(inner_, deep_, stopOnFalse_);
}

} // namespace ZOR_Basis
