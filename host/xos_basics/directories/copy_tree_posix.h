/// \file
/// Copying of a whole tree. For `_posix` sources only.

#ifndef HOST_XOS_BASICS_DIRECTORIES_COPY_TREE_POSIX_H
#define HOST_XOS_BASICS_DIRECTORIES_COPY_TREE_POSIX_H

#include "host/xos_basics/files/entry_posix.h"
#include "host/xos_basics/files/file_copy_posix.h"

namespace host {

struct CopyRules {
    /// A file takes the place of a file that is there.
    bool overwrite;
    /// Directories are copied, too.
    bool recursive;
    /// No other process sees the target yet, so its entries need no temporary names.
    bool unseen;
};

/// Copies what lies in the directory `from` into the directory `to`, and `from`'s permissions and time where `unseen`.
bool copyTree(Descriptor from, struct stat const& fromStatus, Descriptor to, CopyRules rules);

/// Copies one entry that is neither file nor directory as what it is.
bool copySpecial(int fromAt, char const* from, struct stat const& status, int toAt, char const* to, CopyRules rules);

} // namespace host

#endif
