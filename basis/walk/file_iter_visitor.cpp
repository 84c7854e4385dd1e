#include "zor_basis/walk/file_iter_visitor.h"

namespace ZOR_Basis {

bool FileIterVisitor::perform(FileEntry* entry) {
    if (!entry->isDir()) return true;
    // kept walk-07: restoring the path would cost an unused copy for every directory.
    it_->setPath(entry->getFullPath());
    return it_->doIt(inner_, deep_, stopOnFalse_);
}

} // namespace ZOR_Basis
