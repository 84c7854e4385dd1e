/// \file
/// The open directories from the top of a tree down to the place of work. For `_posix` sources only.
///
/// However deep the tree is, only the last few are held open. The others are found again through "..", with a check
/// that they are the same: a directory that was moved meanwhile leads nowhere else.

#ifndef HOST_XOS_BASICS_DIRECTORIES_DIRECTORY_CHAIN_POSIX_H
#define HOST_XOS_BASICS_DIRECTORIES_DIRECTORY_CHAIN_POSIX_H

#include "host/xos_basics/files/descriptor_posix.h"

#include <cstddef>
#include <sys/types.h>
#include <vector>

namespace host {

class DirectoryChain {
public:
    /// Adds a directory that lies in the lowest one.
    /// \return false, with errno: the chain is as it was
    bool push(Descriptor directory);
    /// Makes sure that the directory above the lowest is open.
    /// \return false, with errno ESTALE or another: it cannot
    ///     be found again
    bool findAbove();
    /// Leaves the lowest directory, once the one above has been found.
    void pop() { levels_.pop_back(); }

    int lowest() const { return levels_.back().directory.get(); }
    std::size_t depth() const { return levels_.size(); }

private:
    static constexpr std::size_t KEPT_OPEN = 24;

    struct Level {
        Descriptor directory;
        dev_t device;
        ino_t inode;
    };

    std::vector<Level> levels_;
};

} // namespace host

#endif
