/// \file
/// Removal of a whole tree. For `_posix` sources only.

#ifndef HOST_XOS_BASICS_DIRECTORIES_REMOVE_TREE_POSIX_H
#define HOST_XOS_BASICS_DIRECTORIES_REMOVE_TREE_POSIX_H

namespace host {

/// Removes the entry `name` of an open directory, with everything in it.
///
/// Works from open directories only and opens no link, so that whatever is exchanged meanwhile, nothing outside the
/// tree is touched. What cannot be removed stays, with the directories above it; all the rest goes. errno is the first
/// failure's.
bool removeTree(int at, char const* name);

} // namespace host

#endif
