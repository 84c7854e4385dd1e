#include "zor_basis/walk/file_move_visitor.h"

#include "basis/files/whole_entry.h"
#include "basis/ground/choices.h"
#include "basis/walk/transfer.h"
#include "zor_basis/files/dir.h"
#include "zor_basis/files/file.h"

namespace ZOR_Basis {

bool FileMoveVisitor::perform(FileEntry* entry) {
    if (isAtTarget(*entry, target_)) return true;
    Transfer const names(*entry, target_);
    if (!freeDestination(names.destination, overwrite_)) return false;
    return entry->isFile() ? File::Move(names.destination, names.source, OVERWRITING, WITHOUT_PARENTS)
                           : Dir::Move(names.destination, names.source, OVERWRITING, WITHOUT_SECOND_FLAG);
}

} // namespace ZOR_Basis
