#include "basis/files/dir_iter.h"

namespace ZOR_Basis {

void SystemDirIterW::finish() {
    close();
    removeWildCard();
    first_ = true;
    lastError_ = 0;
}

} // namespace ZOR_Basis
