/// \file
/// What copying and moving an entry into a directory have in common.

#ifndef BASIS_WALK_TRANSFER_H
#define BASIS_WALK_TRANSFER_H

#include "zor_basis/files/f_path.h"
#include "zor_basis/files/file_entry.h"

namespace ZOR_Basis {

/// Both names of one transfer.
struct Transfer {
    Transfer(FileEntry const& entry, FPath const& target);

    FPath source;
    FPath destination;
};

/// Tells whether an entry is already in the target, by the text of its directory.
bool isAtTarget(FileEntry const& entry, FPath const& target);

} // namespace ZOR_Basis

#endif
