/// \file
/// `zbLinkOrCopy`: gives a file another name, or copies it.
///
/// \error when the system causes a false, 0 or null, the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_LINK_OR_COPY_H
#define ZOR_BASIS_WALK_LINK_OR_COPY_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

/// Makes `dst` another name (a hard link) of the file `src`, or a copy if no link can be made.
/// \param overwrite  removes an existing file at `dst` first
/// \kept walk-10: unlike in `File::LinkOrCopy` the source comes first, and without `overwrite` an existing `dst` counts
///     as success: the result is true and nothing changes
/// \return whether `dst` exists afterwards
/// \thread thread-safe as far as the file system is
ZB_API bool zbLinkOrCopy(char const* src, char const* dst, bool overwrite);

} // namespace ZOR_Basis

#endif
