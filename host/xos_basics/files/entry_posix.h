/// \file
/// Steps on single entries that files and trees share: places and new names. For `_posix` sources only.
///
/// An entry is identified by the descriptor of its directory and its name there, so no other process can exchange its
/// path between two steps. A function that fails sets errno.

#ifndef HOST_XOS_BASICS_FILES_ENTRY_POSIX_H
#define HOST_XOS_BASICS_FILES_ENTRY_POSIX_H

#include "host/xos_basics/files/descriptor_posix.h"

#include <cerrno>
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

/// Makes up a name that almost certainly no entry of a directory has.
std::string temporaryName();

/// Makes something new under a temporary name.
/// \param make  called with a name until it does not fail with EEXIST
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

/// Renames; fails with EEXIST if the new name exists, even if another process made it a moment before.
bool renameToNew(int fromAt, char const* from, int toAt, char const* to);

/// Gives the finished temporary entry its name. A failure removes it.
/// \param overwrite  also in place of a file
bool putInPlace(int at, std::string const& temporary, char const* name, bool overwrite);

/// Whether a file may be put in the place of what has this status; errno says why not. A directory stays, and so does
/// everything that is no file at all: a device, a pipe.
bool isReplaceable(struct stat const& status);

} // namespace host

#endif
