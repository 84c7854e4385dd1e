#include "zor_basis/files/dir_iterator.h"

#include "zor_basis/text/convert.h"

namespace ZOR_Basis {

void DirIterImplW::setPath(WStr const& path) {
    path_ = path;
    directoryLength_ = NOT_APPENDED;
}

void DirIterImplW::setWildCard(char const* wildcard) { Convert::LocalToWide(wildcard, wildcard_); }

void DirIterImplW::appendWildCard() {
    // kept list-dir-01: the system is called with this very path.
    directoryLength_ = path_.size();
    if (wildcard_.empty()) {
        path_.add(ZB_W("*"));
    } else {
        path_.add(wildcard_);
    }
}

void DirIterImplW::removeWildCard() {
    if (directoryLength_ != NOT_APPENDED) path_.cut(directoryLength_);
    directoryLength_ = NOT_APPENDED;
}

bool DirIterImplW::isWanted(bool isDirectory) const {
    switch (type_ & LOOK_BOTH) {
    case LOOK_FILES:
        return !isDirectory;
    case LOOK_DIRS:
        return isDirectory;
    default:
        return true;
    }
}

} // namespace ZOR_Basis
