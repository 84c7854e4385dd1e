// Used by tree_posix.cpp; its counterpart for Windows works with paths.

#include "host/xos_basics/directories/directory_chain_posix.h"

#include <fcntl.h>
#include <sys/stat.h>

namespace host {

bool DirectoryChain::push(Descriptor directory) {
    if (levels_.size() >= KEPT_OPEN) {
        Level& oldest = levels_[levels_.size() - KEPT_OPEN];
        struct stat status {};
        if (oldest.directory) {
            if (::fstat(oldest.directory.get(), &status) != 0) return false;
            oldest.device = status.st_dev;
            oldest.inode = status.st_ino;
            oldest.directory = Descriptor{};
        }
    }
    levels_.push_back({std::move(directory), 0, 0});
    return true;
}

bool DirectoryChain::findAbove() {
    if (levels_.size() < 2) return true;
    Level& above = levels_[levels_.size() - 2];
    if (above.directory) return true;
    Descriptor found{::openat(lowest(), "..", O_PATH | O_DIRECTORY | O_CLOEXEC)};
    struct stat status {};
    if (!found || ::fstat(found.get(), &status) != 0) return false;
    if (status.st_dev != above.device || status.st_ino != above.inode) return failWith(ESTALE);
    above.directory = std::move(found);
    return true;
}

} // namespace host
