#include "zor_basis/walk/file_delete_visitor.h"

#include "basis/files/last_error.h"
#include "zor_basis/files/dir.h"
#include "zor_basis/files/f_stat.h"
#include "zor_basis/files/file.h"

using namespace ZOR_Basis;

bool FileDeleteVisitor::perform(FileEntry* entry) { return zbCheckRemoveFileDir(entry->getFullPath(), true); }

bool zbCheckRemoveFileDir(FPath const& path, bool remove) {
    FStat const entry(path);
    if (!entry.exist()) return true;
    if (!remove) return refuse(Reason::ALREADY_THERE);
    return entry.isDir() ? Dir::Rem(path, true, false) : File::Rem(path, true, false);
}
