#include "zor_basis/walk/link_or_copy.h"

#include "zor_basis/files/dir.h"
#include "zor_basis/files/file.h"

namespace ZOR_Basis {

bool zbLinkOrCopy(char const* src, char const* dst, bool overwrite) {
    if (Dir::Exist(dst)) {
        // kept walk-10: jobs that share a resource all ask for it, and the first has brought it.
        if (!overwrite) return true;
        File::Rem(dst, true, false);
    }
    return Dir::Link(dst, src) || File::Copy(dst, src, true, false);
}

} // namespace ZOR_Basis
