/// \file
/// Complete copies of regular files. For `_posix` sources only. A function that fails sets errno.

#ifndef HOST_XOS_BASICS_FILES_FILE_COPY_POSIX_H
#define HOST_XOS_BASICS_FILES_FILE_COPY_POSIX_H

#include "host/xos_basics/files/descriptor_posix.h"

#include <cstddef>
#include <memory>
#include <sys/stat.h>

namespace host {

/// The permission bits that a copy receives. Those that lend the owner's rights go only to a copy with the same owner.
mode_t permissionsOfCopy(struct stat const& source);

/// Gives the open copy the permissions and the modification time of its source.
bool keepModeAndTime(int copy, struct stat const& source);

/// Copies regular files with one buffer for all of them.
class FileCopier {
public:
    /// Makes the entry `name` a complete copy of an open file. On failure there is no such entry.
    bool copyToNew(int source, struct stat const& status, int at, char const* name);
    /// The same through a temporary name.
    /// \param overwrite  allows a file to be replaced
    bool copyTo(int source, struct stat const& status, int at, char const* name, bool overwrite);

private:
    bool copyContent(int source, struct stat const& status, int copy);
    bool copyHoles(int source, struct stat const& status, int copy);
    /// Copies up to `size` bytes from the descriptors' positions on.
    /// \param size  -1: to the end of the file
    bool copyRange(int source, int copy, off_t size);
    bool copyByBuffer(int source, int copy, off_t size, off_t expected);

    std::unique_ptr<char[]> buffer_;
};

/// Opens a regular file as the source of a copy.
/// \param flags  added to the open flags
Descriptor openSource(int at, char const* name, int flags, struct stat& status);

} // namespace host

#endif
