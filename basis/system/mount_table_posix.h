/// \file
/// What is mounted where.

#ifndef BASIS_SYSTEM_MOUNT_TABLE_POSIX_H
#define BASIS_SYSTEM_MOUNT_TABLE_POSIX_H

#include "zor_basis/files/f_path.h"
#include "zor_basis/text/buf_str.h"

namespace ZOR_Basis {

struct Mount {
    /// The device or the share, the kind of file system, and the directory at which it is seen.
    BufStr<255> source;
    BufStr<15> kind;
    BufStr<255> directory;
};

/// The path as an absolute one without links, as far as it exists.
FPath absolutePath(Str const& path);

/// The mount on which an absolute path lies: the one with the longest directory, of several the last.
/// \return false if the table cannot be read or has no such mount
bool findMount(FPath const& path, Mount& mount);

/// Whether a kind of file system has its data on a disk or in the memory of this machine.
bool isLocalKind(Str const& kind);

/// The network path of a mounted share: "//server/share".
/// \return false if it is not a share
bool networkPath(Mount const& mount, FPath& path);

} // namespace ZOR_Basis

#endif
