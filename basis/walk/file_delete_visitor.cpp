#include "zor_basis/walk/file_delete_visitor.h"

#include "basis/files/whole_entry.h"
#include "basis/ground/choices.h"

using namespace ZOR_Basis;

bool FileDeleteVisitor::perform(FileEntry* entry) { return freeDestination(entry->getFullPath(), OVERWRITING); }

bool zbCheckRemoveFileDir(FPath const& path, bool remove) { return freeDestination(path, remove); }
