/// \file
/// The entries that no walk reports and no walk enters.

#ifndef BASIS_WALK_PASSED_OVER_H
#define BASIS_WALK_PASSED_OVER_H

#include "basis/platform/xos_basics.h"

namespace ZOR_Basis {

inline bool isPassedOver(char const* name) {
    // kept walk-03: the folder that another system leaves beside the files of a job does not belong to it.
    return xos_StrCmp(name, "__MACOS") == 0;
}

} // namespace ZOR_Basis

#endif
