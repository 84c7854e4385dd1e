#include "zor_basis/walk/file_delete_visitor.h"

#include "basis/files/whole_entry.h"
#include "basis/ground/choices.h"

namespace ZOR_Basis {

bool FileDeleteVisitor::perform(FileEntry* entry) { return freeDestination(entry->getFullPath(), OVERWRITING); }

} // namespace ZOR_Basis

bool zbCheckRemoveFileDir(ZOR_Basis::FPath const& path, bool remove) {
    return ZOR_Basis::freeDestination(path, remove);
}
