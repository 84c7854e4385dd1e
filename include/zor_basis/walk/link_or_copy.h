/// \file
/// `zbLinkOrCopy`: gives a file another name, or copies it.
///
/// \error  after a false, 0 or null that comes from the system the last error says why (docs/reasons.md)

#ifndef ZOR_BASIS_WALK_LINK_OR_COPY_H
#define ZOR_BASIS_WALK_LINK_OR_COPY_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

/// Makes `dst` another name of the file `src`, or a copy where that cannot be.
/// \param overwrite  removes first what file is at `dst`
/// \kept walk-10: the source comes first, unlike in `File::LinkOrCopy`, and something at `dst` is as good without
///     `overwrite`: true, and nothing changes
/// \return whether there is a `dst` now
/// \thread  thread-safe as far as the file system is
ZB_API bool zbLinkOrCopy(char const* src, char const* dst, bool overwrite);

} // namespace ZOR_Basis

#endif
