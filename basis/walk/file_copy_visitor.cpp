#include "zor_basis/walk/file_copy_visitor.h"

#include "basis/walk/transfer.h"
#include "zor_basis/files/dir.h"
#include "zor_basis/files/file.h"
#include "zor_basis/walk/file_delete_visitor.h"

namespace ZOR_Basis {

bool FileCopyVisitor::perform(FileEntry* entry) {
    if (isAtTarget(*entry, target_)) return true;
    Transfer const names(*entry, target_);
    if (!zbCheckRemoveFileDir(names.destination, overwrite_)) return false;
    return entry->isFile() ? File::Copy(names.destination, names.source, true, false)
                           : Dir::Copy(names.destination, names.source, recursive_, true, false);
}

} // namespace ZOR_Basis
