#include "zor_basis/walk/link_or_copy.h"

#include "basis/files/whole_entry.h"
#include "zor_basis/files/dir.h"

namespace ZOR_Basis {

bool zbLinkOrCopy(char const* src, char const* dst, bool overwrite) {
    if (Dir::Exist(dst)) {
        // kept walk-10: all jobs that share a resource request it, and the first of them has brought it.
        if (!overwrite) return true;
        // A directory stays, and then neither a link nor a copy can be made.
        removeFile(dst);
    }
    return linkOrCopy(dst, src);
}

} // namespace ZOR_Basis
