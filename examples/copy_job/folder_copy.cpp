#include "examples/copy_job/folder_copy.h"

#include "examples/copy_job/choices.h"
#include "examples/copy_job/each_entry.h"

#include <zor_basis/walk.h>

using namespace ZOR_Basis;

bool FolderCopy::run(FPath const& source, FPath const& target) {
    bool const good = copyFolder(source, target);
    progress_.finish();
    return good;
}

bool FolderCopy::copyFolder(FPath const& source, FPath const& target) {
    if (Dir::New(target, WITHOUT_PARENTS)) return copyFiles(source, target) && copyFolders(source, target);
    failedAt_ = target;
    return false;
}

bool FolderCopy::copyFiles(FPath const& source, FPath const& target) {
    FileCopyVisitor copier(target, OVERWRITING, DEEP);
    return forEachEntry(source, LOOK_FILES, [&](FileEntry& entry) {
        if (!copier.perform(&entry)) {
            failedAt_ = entry.getFullPath();
            return false;
        }
        progress_.add(entry.getSize());
        return true;
    });
}

bool FolderCopy::copyFolders(FPath const& source, FPath const& target) {
    return forEachEntry(source, LOOK_DIRS, [&](FileEntry& entry) {
        progress_.add(0);
        return copyFolder(entry.getFullPath(), FPath(target, entry.getName()));
    });
}
