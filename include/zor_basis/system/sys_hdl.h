/// \file
/// `SysHdl`: a user who has been logged on. Made by `Sys::loginUser`, owned by its caller; deleting it logs the user off.
///
/// \thread  one thread at a time

#ifndef ZOR_BASIS_SYSTEM_SYS_HDL_H
#define ZOR_BASIS_SYSTEM_SYS_HDL_H

#include "zor_basis/export.h"

namespace ZOR_Basis {

class ZB_API SysHdl {
public:
    SysHdl() = default;
    SysHdl(SysHdl const&) = delete;
    SysHdl& operator=(SysHdl const&) = delete;

    /// Whether there is a user behind it; of the base class itself there is none.
    virtual bool isValid();
    virtual ~SysHdl();
};

} // namespace ZOR_Basis

#endif
