/// \file
/// Steps on single entries that files and trees share: places, new names, complete copies. For `_posix` sources only.
///
/// An entry is identified by the descriptor of its directory and its name there, so no other process can exchange its
/// path between two steps. What fails leaves errno.

#ifndef HOST_XOS_BASICS_FILES_ENTRY_POSIX_H
#define HOST_XOS_BASICS_FILES_ENTRY_POSIX_H

#include "host/xos_basics/files/descriptor.h"

#include <memory>
#include <string>
#include <sys/stat.h>

namespace host {

/// Where an entry is or will be.
struct Place {
    Descriptor directory;
    /// Never empty; "." for the directory itself.
    std::string name;

    int at() const { return directory.get(); }
};

/// Opens the directory of an entry.
bool findPlace(char const* path, Place& place);

inline bool sameEntry(struct stat const& a, struct stat const& b) {
    return a.st_dev == b.st_dev && a.st_ino == b.st_ino;
}

/// A name that nothing in a directory bears yet, in all likelihood.
std::string temporaryName();

/// Makes something new under a temporary name. \param make  called with a name until it does not fail with EEXIST
/// \return the name; empty: failed
template <class Make>
std::string makeTemporary(Make make) {
    for (int attempt = 0; attempt < 16; ++attempt) {
        std::string name = temporaryName();
        if (make(name.c_str())) return name;
        if (errno != EEXIST) break;
    }
    return {};
}

/// Renames, and fails with EEXIST when something has the new name already, at whatever moment it came there.
bool renameToNew(int fromAt, char const* from, int toAt, char const* to);

/// Gives the finished temporary entry its name. A failure removes it. \param overwrite  also in place of a file
bool putInPlace(int at, std::string const& temporary, char const* name, bool overwrite);

/// Whether a file may be put in the place of what has this status; errno says why not. A directory stays, and so does
/// everything that is no file at all: a device, a pipe.
bool isReplaceable(struct stat const& status);

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
    /// Copies up to `size` bytes from the descriptors' positions on. \param size  -1: to the end of the file
    bool copyRange(int source, int copy, off_t size);
    bool copyByBuffer(int source, int copy, off_t size, off_t expected);

    std::unique_ptr<char[]> buffer_;
};

/// Opens a regular file as the source of a copy. \param flags  added to the open flags
Descriptor openSource(int at, char const* name, int flags, struct stat& status);

} // namespace host

#endif
