#include "basis/walk/transfer.h"

namespace ZOR_Basis {

Transfer::Transfer(FileEntry const& entry, FPath const& target)
    : source(entry.getDir(), entry.getName()), destination(target, entry.getName()) {}

bool isAtTarget(FileEntry const& entry, FPath const& target) { return entry.getDir() == target; }

} // namespace ZOR_Basis
